#include "inventory/product.h"

#include "inventory/property_text.h"
#include "runtime/trace.h"

namespace zmlr
{

namespace
{

constexpr const char* log_source = "AdapterHelper";

} // namespace

Ref<ZEMLAR_Product> getProductInstance(const _hbaInfo& info)
{
    const Scope_Trace trace(log_source);
    Ref<ZEMLAR_Product> product(ZEMLAR_Product::create());
    product->ElementName.set(info.display_name());
    product->Caption.set(info.display_name());
    product->Description.set(info.display_name());
    product->Name.set("ZEMLAR CIM Provider");
    product->IdentifyingNumber.set(property_text(info.serial_number));
    product->Vendor.set(property_text(info.manufacturer));
    product->Version.set(property_text(info.firmware_version));
    return product;
}

} // namespace zmlr
