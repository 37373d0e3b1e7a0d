// CMPI_Data: a CMPI value on its way to the broker, with the object that was made for it.
#pragma once

#include "cmpi/cmpi_objects.h"

#include <cmpimacs.h>

#include <cstring>
#include <utility>
#include <vector>

namespace zmlr
{

// Releases its string, datetime, path, instance or array at its end, an array before its elements: brokers copy what is set
// as a property or key. A long enumeration must not pile up objects until its request is over, nor a thread that delivers
// alerts until it ends.
class CMPI_Data
{
public:
    using Elements = std::vector<CMPI_Data>;

    CMPI_Data() = default;
    ~CMPI_Data() { release(); }
    CMPI_Data(CMPI_Data&& x) noexcept { *this = std::move(x); }
    CMPI_Data& operator=(CMPI_Data&& x) noexcept;

    // A value without an object behind it.
    void set(CMPIType type, const CMPIValue& value)
    {
        release();
        _data = {type, CMPI_goodValue, value};
    }
    void set_null(CMPIType type)
    {
        release();
        _data = {type, CMPI_nullValue, {.uint64 = 0}};
    }

    // Takes over an object, an array with the elements that it points to; false when there is none (the broker could not make
    // it).
    template <class Object> bool adopt(CMPIType type, Object* object, Elements elements = {})
    {
        if (!object)
            return false;
        CMPIValue value = {};
        std::memcpy(&value, &object, sizeof(object)); // every pointer lies at the union's start
        set(type, value);
        _release = [](const CMPIValue& owned)
        {
            Object* last = nullptr;
            std::memcpy(&last, &owned, sizeof(last));
            CMPI_Release()(last);
        };
        _elements = std::move(elements);
        return true;
    }

    // Leaves its object, an array's elements too, to the broker, which frees it when the request ends.
    void leave()
    {
        _release = nullptr;
        for (CMPI_Data& element : _elements)
            element.leave();
    }

    CMPIType type() const { return _data.type; }
    const CMPIValue* value() const { return CMIsNullValue(_data) ? nullptr : &_data.value; }

private:
    void release()
    {
        if (_release)
            release_object();
    }
    void release_object();

    CMPIData _data = {CMPI_null, CMPI_nullValue, {.uint64 = 0}};
    void (*_release)(const CMPIValue& owned) = nullptr; // of the object, when there is one
    Elements _elements;                                 // of the array
};

} // namespace zmlr
