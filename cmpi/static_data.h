// CMPI_Static_Data: what a CIM server holds pointers to. One per provider, all zero when the module is loaded.
//
// The records {hdl, ft} that the factories hand out lie in here: hdl points back at the static data, through which a
// request finds its adapter. They stay readable when the adapter is gone: the mark tells.
#pragma once

#include "runtime/magic.h"
#include "runtime/types.h"

#include <cmpift.h>

#include <cstddef>

namespace zmlr
{

class CMPI_Adapter;

inline constexpr uint32 STATIC_DATA_MAGIC = 0x5DE2B131;
inline constexpr std::size_t MI_NAME_SIZE = 256; // with the terminator

struct CMPI_Static_Data
{
    uint32 magic; // STATIC_DATA_MAGIC while an adapter is attached, DESTROYED_MAGIC after it
    CMPI_Adapter* adapter;
    CMPIInstanceMIFT instance_ft;
    CMPIMethodMIFT method_ft;
    CMPIIndicationMIFT indication_ft;
    CMPIAssociationMIFT association_ft;
    CMPIInstanceMI instance_mi;
    CMPIMethodMI method_mi;
    CMPIAssociationMI association_mi;
    CMPIIndicationMI indication_mi;
    char inst_mi_name[MI_NAME_SIZE];
    char meth_mi_name[MI_NAME_SIZE];
    char indic_mi_name[MI_NAME_SIZE];
    char assoc_mi_name[MI_NAME_SIZE];
};

} // namespace zmlr
