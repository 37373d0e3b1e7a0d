// Registration: one record per provider, linked into the module's list that cimple_module() hands out.
//
// Plain data, readable by outside tools (the embedded CIM server finds the served classes through it).
#pragma once

#include "runtime/meta.h"

namespace zmlr
{

struct Registration;

// The operations of a provider procedure.
enum Operation : int
{
    OPERATION_GET_META_CLASS = 0,
    OPERATION_CREATE_PROVIDER = 1,
    OPERATION_DESTROY_PROVIDER = 2,
    OPERATION_LOAD = 3,
    OPERATION_UNLOAD = 4,
    OPERATION_GET_INSTANCE = 5,
    OPERATION_ENUM_INSTANCES = 6,
    OPERATION_CREATE_INSTANCE = 7,
    OPERATION_DELETE_INSTANCE = 8,
    OPERATION_MODIFY_INSTANCE = 9,
    OPERATION_INVOKE_METHOD = 10,
    OPERATION_ENABLE_INDICATIONS = 11,
    OPERATION_DISABLE_INDICATIONS = 12,
    OPERATION_GET_REPOSITORY = 13,
    OPERATION_ENUM_ASSOCIATOR_NAMES = 14,
    OPERATION_ENUM_REFERENCES = 15,
    OPERATION_ENUM_ASSOCIATORS = 16
};

// The uniform way into a provider: an operation and up to eight untyped arguments. Answers the operation's status, or -1
// for an operation (or method name) that the class does not have.
using Provider_Proc = int (*)(const Registration* registration, int operation, void* arg0, void* arg1, void* arg2, void* arg3,
                              void* arg4, void* arg5, void* arg6, void* arg7);

struct Registration
{
    const char* module_name;   // "zmlrprovider_Module"
    const char* provider_name; // the class name followed by "_Provider"
    Provider_Proc provider_proc;
    const Meta_Class* meta_class;
    const Registration* next; // null at the list's end
};

} // namespace zmlr

// The head of the module's list of providers.
extern "C" const zmlr::Registration* cimple_module();
