// The user for whom a thread calls the module: what the module reads as CMPIPrincipal.
#pragma once

#include "cimserver/model/values.h"

#include <string>

namespace cimserver
{

// From now on the calling thread works for the user, until the end of the scope.
class Principal_Scope
{
public:
    explicit Principal_Scope(std::string user);
    ~Principal_Scope();
    Principal_Scope(const Principal_Scope&) = delete;
    Principal_Scope& operator=(const Principal_Scope&) = delete;

    // Whom the calling thread works for; "root", the server itself, outside any scope.
    static const Text& current();

private:
    Text _before;
};

} // namespace cimserver
