// The file that keeps filters, destinations and subscriptions over a restart: DIR/subscriptions.json.
#pragma once

#include "cimserver/model/values.h"
#include "cimserver/security/private_file.h"
#include "runtime/meta.h"

#include <array>
#include <string>
#include <vector>

namespace cimserver
{

enum class Subscription_Kind
{
    filter,
    destination,
    subscription
};

const zmlr::Meta_Class& class_of(Subscription_Kind kind); // by which clients manage them

using Stored_Instances = std::array<std::vector<Instance>, 3>; // one list a kind, in the order of the enumerators

class Subscription_Store
{
public:
    // Makes the folder, mode 0700, unless it is there. It belongs to this process until the end of the object. Throws
    // std::runtime_error when it cannot be used: not private, or another server uses it.
    explicit Subscription_Store(const std::string& folder);

    // What was saved last; nothing when nothing was. The instances' values are texts, booleans and paths, to be converted to
    // the types of their classes. Throws std::runtime_error, that names the file and the fault, when it is damaged; it is
    // left as it is.
    Stored_Instances load() const;

    // Replaces what was saved, all or nothing. Throws std::system_error.
    void save(const Stored_Instances& instances) const;

    const std::string& file() const { return _file; }

private:
    const Folder_Lock _lock;
    const std::string _file;
};

} // namespace cimserver
