#include "runtime/value.h"

#include "runtime/features.h"
#include "runtime/log.h"

#include <cstring>
#include <utility>

namespace zmlr
{

namespace
{

constexpr const char* log_source = "Value";

Log_Call_Frame warning(int line = __builtin_LINE()) { return {LL_WARN, log_source, line}; }

bool is_array(Value::Type type) { return type >= Value::BOOLEAN_ARRAY; }

Value::Type element_of(Value::Type type) { return is_array(type) ? static_cast<Value::Type>(type - Value::BOOLEAN_ARRAY) : type; }

// How a scalar, or an array's element, is made and destroyed.
const __Array_Traits& traits_of(Value::Type type)
{
    const Value::Type element = element_of(type);
    return element == Value::INSTANCE ? __pointer_array_traits : __cim_array_traits[element];
}

template <class Action> void for_each_instance(const Value& value, Action action)
{
    if (Instance* const* instance = value.get_if<Instance*>())
        action(*instance);
    else if (const auto* instances = value.get_if<Array<Instance*>>())
        for (const Instance* element : *instances)
            action(element);
}

void ref_all(const Value& value)
{
    for_each_instance(value, [](const Instance* instance) { ref(instance); });
}

// Bytes that a value of the type takes in an instance.
std::size_t size_of(Value::Type type) { return is_array(type) ? sizeof(__Array_Rep*) : traits_of(type).elem_size; }

} // namespace

Value::Type type_of(const Meta_Feature* feature)
{
    if (const Meta_Property* property = to_property(feature))
        return type_of(property);
    if (is_reference(feature))
        return is_array(as_reference(feature)) ? Value::INSTANCE_ARRAY : Value::INSTANCE;
    return Value::NONE;
}

Value::Value(const Value& x) : _null(x._null)
{
    construct(x._type, x.content());
    ref_all(*this);
}

Value::Value(Value&& x) noexcept { swap(x); }

Value& Value::operator=(Value x) noexcept
{
    swap(x);
    return *this;
}

// Handles hold no pointer to themselves: their bytes may move.
void Value::swap(Value& x) noexcept
{
    std::swap(_type, x._type);
    std::swap(_null, x._null);
    std::swap(_owned, x._owned);
    std::swap(_elsewhere, x._elsewhere);
    std::swap(_held, x._held);
}

void Value::release() noexcept
{
    for_each_instance(*this, [](const Instance* instance) { unref(instance); });
    if (is_array(_type))
        __destruct(reinterpret_cast<__Array_Rep*&>(_held));
    else if (traits_of(_type).destruct)
        traits_of(_type).destruct(_held, 1);
}

// Of an empty value. Nothing is held when it throws.
void Value::construct(Type type, const void* x)
{
    if (is_array(type))
    {
        auto& rep = reinterpret_cast<__Array_Rep*&>(_held);
        if (x)
            __construct(rep, *static_cast<const __Array_Rep* const*>(x));
        else
            __construct(rep, &traits_of(type));
    }
    else if (type != NONE)
    {
        const __Array_Traits& traits = traits_of(type);
        if (traits.construct)
            traits.construct(_held, x, 1);
        else if (x)
            std::memcpy(_held, x, traits.elem_size);
        else
            std::memset(_held, 0, sizeof(_held));
    }
    _type = type;
}

// The copy is made before anything is released: x may be a part of what is held.
void Value::hold(Type type, const void* x)
{
    Value made;
    made.construct(type, x);
    made._null = false;
    swap(made);
}

void Value::hold_moved(Type type, void* array)
{
    Value made;
    made.construct(type, nullptr);
    made._null = false;
    std::swap(reinterpret_cast<__Array_Rep*&>(made._held), *static_cast<__Array_Rep**>(array));
    swap(made);
}

void Value::set_null(Type type)
{
    hold(type, nullptr);
    _null = true;
}

int Value::borrow(const Instance* instance, const Meta_Feature* feature)
{
    check_inst(instance);
    const Meta_Property* property = to_property(feature);
    const Meta_Reference* array = property ? nullptr : to_array_reference(feature);
    borrow(type_of(feature), property || array ? address_of(instance, property ? property->offset : array->offset) : nullptr);
    _null = _type == NONE || is_null(instance, feature);
    if (_type != INSTANCE)
        return _type == NONE ? -1 : 0;
    // The record's field is a pointer to its own class: only its value is taken.
    const Instance* referenced = reference_of(instance, as_reference(feature));
    std::memcpy(_held, &referenced, sizeof(referenced));
    return 0;
}

// Everything is copied and referenced before the instance it is read from may be released.
int Value::set(const Instance* instance, const Meta_Feature* feature)
{
    Value borrowed;
    const int result = borrowed.borrow(instance, feature);
    *this = Value(std::as_const(borrowed));
    return result;
}

namespace
{

bool check_class(const Instance* referenced, const Instance* instance, const Meta_Reference* reference)
{
    if (!referenced || is_subclass(reference->meta_class, referenced->meta_class))
        return true;
    warning().invoke("failed to assign instance of %s to %s.%s", record_of(referenced)->name, record_of(instance)->name,
                     reference->name);
    return false;
}

// Whether the value may be stored into the feature.
bool fits(const Value& value, const Instance* instance, const Meta_Feature* feature)
{
    if (!instance)
    {
        warning().invoke("null instance argument");
        return false;
    }
    check_inst(instance);
    if (value.type() == Value::NONE || value.type() != type_of(feature))
    {
        warning().invoke("type mismatch: %s.%s", record_of(instance)->name, feature->name);
        return false;
    }
    bool good = true;
    if (is_reference(feature))
        for_each_instance(value, [&](const Instance* referenced)
                          { good = good && check_class(referenced, instance, as_reference(feature)); });
    return good;
}

} // namespace

int Value::get(Instance* instance, const Meta_Feature* feature) const
{
    return fits(*this, instance, feature) ? Value(*this).give(instance, feature) : -1;
}

int Value::give(Instance* instance, const Meta_Feature* feature)
{
    if (!fits(*this, instance, feature))
        return -1;
    if (!_owned)
        *this = Value(std::as_const(*this));
    if (_null && _type == INSTANCE)
        set_null(INSTANCE); // unsets the reference

    const Meta_Property* property = to_property(feature);
    const Meta_Reference* reference = property ? nullptr : as_reference(feature);
    void* place = address_of(instance, property ? property->offset : reference->offset);
    unsigned char before[sizeof(_held)];
    const std::size_t size = size_of(_type);
    std::memcpy(before, place, size);
    std::memcpy(place, _held, size);
    std::memcpy(_held, before, size);
    if (property)
        null_of(instance, property) = _null ? 1 : 0;
    else if (is_array(reference))
        null_of(instance, reference) = _null ? 1 : 0;
    return 0;
}

} // namespace zmlr
