// Server_Name_Spaces: "root/zemlar" holds the module's classes, "root/PG_InterOp" the server's; that one answers as "interop" and
// "root/interop" too, where other clients look for it, and CIM_Namespace lists all four.
//
// Names are compared without regard to case, and a slash in front or at the end does not count; another name is
// CIM_ERR_INVALID_NAMESPACE.
#pragma once

#include "cimserver/interop/interop_operations.h"
#include "cimserver/operations/module_operations.h"

namespace cimserver
{

class Server_Name_Spaces : public Name_Spaces
{
public:
    // From now on this object answers the module's up-calls. The destructor closes the module, which must outlive this object.
    explicit Server_Name_Spaces(Module& module);
    ~Server_Name_Spaces() override;

    Own_Operations& own() { return _interop.own(); }

    using Name_Spaces::at;
    Operations& at(const std::string& name_space, const std::string& class_name) override;

private:
    Module& _module;
    Module_Operations _served;
    Interop_Operations _interop;
};

} // namespace cimserver
