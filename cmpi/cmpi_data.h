// CMPI_Data: a CMPI value on its way to the broker, with the object that was made for it.
#pragma once

#include "cmpi/cmpi_objects.h"

#include <cmpimacs.h>

namespace zmlr
{

// Releases its string, datetime, path, instance or array at its end: brokers copy what is set as a property or key, and a
// long enumeration must not pile up objects until its request is over.
class CMPI_Data
{
public:
    CMPI_Data() = default;
    ~CMPI_Data() { release(); }
    CMPI_Data(const CMPI_Data&) = delete;
    CMPI_Data& operator=(const CMPI_Data&) = delete;

    // A value without an object behind it.
    void set(CMPIType type, const CMPIValue& value);
    void set_null(CMPIType type);

    // Takes over an object; false when there is none (the broker could not make it).
    bool adopt(CMPIString* string);
    bool adopt(CMPIDateTime* datetime);
    bool adopt(CMPIObjectPath* path);
    bool adopt(CMPIInstance* instance);
    bool adopt(CMPIArray* array, CMPIType element_type);

    CMPIType type() const { return _data.type; }
    const CMPIValue* value() const { return CMIsNullValue(_data) ? nullptr : &_data.value; }

    // Gives the object up: it is the broker's to free from now on.
    void leave() { _owner = false; }

private:
    void own(CMPIType type, const CMPIValue& value);
    void release();

    CMPIData _data = {CMPI_null, CMPI_nullValue, {}};
    bool _owner = false;
};

} // namespace zmlr
