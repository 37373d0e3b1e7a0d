#include "runtime/value.h"

#include "runtime/features.h"
#include "runtime/log.h"

#include <array>
#include <type_traits>

namespace zmlr
{

// The view of a content by the type code, through tables that are indexed as its alternatives are.
struct Value_Access
{
    using Content = Value::Content;

    static constexpr std::size_t num_scalars = num_types + 1; // with INSTANCE
    static_assert(std::variant_size_v<Content> == 1 + 2 * num_scalars);

    static Value::Type type_at(std::size_t index)
    {
        const std::size_t code = index <= num_scalars ? index - 1 : index - 1 - num_scalars + Value::BOOLEAN_ARRAY;
        return index == 0 ? Value::NONE : static_cast<Value::Type>(code);
    }

    // The index of a type's alternative; 0 for NONE and for what is no type.
    static std::size_t index_of(Value::Type type)
    {
        const auto code = static_cast<std::size_t>(type);
        if (code < num_scalars)
            return 1 + code;
        const std::size_t element = code - Value::BOOLEAN_ARRAY;
        return element < num_scalars ? 1 + num_scalars + element : 0;
    }

    template <class T> static Content load(const void* data)
    {
        if constexpr (std::is_same_v<T, std::monostate>)
            return {};
        else
            return data ? Content(std::in_place_type<T>, *static_cast<const T*>(data)) : Content(std::in_place_type<T>);
    }

    template <class T> static void store(const Content& content, void* data)
    {
        if constexpr (!std::is_same_v<T, std::monostate>)
            *static_cast<T*>(data) = *std::get_if<T>(&content);
    }

    template <std::size_t... I> static Content load(std::size_t index, const void* data, std::index_sequence<I...>)
    {
        static constexpr std::array table = {&load<std::variant_alternative_t<I, Content>>...};
        return table[index](data);
    }

    template <std::size_t... I> static void store(const Content& content, void* data, std::index_sequence<I...>)
    {
        static constexpr std::array table = {&store<std::variant_alternative_t<I, Content>>...};
        table[content.index()](content, data);
    }

    using All = std::make_index_sequence<std::variant_size_v<Content>>;

    // The value of a type that lies at the address, or the type's zero value when there is none.
    static Content content_at(Value::Type type, const void* data) { return load(index_of(type), data, All()); }
    static void store_at(const Content& content, void* data) { store(content, data, All()); }

    template <class Action> static void for_each_instance(const Content& content, Action action)
    {
        if (Instance* const* instance = std::get_if<Instance*>(&content))
            action(*instance);
        else if (const auto* instances = std::get_if<Array<Instance*>>(&content))
            for (const Instance* element : *instances)
                action(element);
    }

    static void ref_all(const Content& content)
    {
        for_each_instance(content, [](const Instance* instance) { ref(instance); });
    }

    static void unref_all(const Content& content)
    {
        for_each_instance(content, [](const Instance* instance) { unref(instance); });
    }
};

namespace
{

constexpr const char* log_source = "Value";

Log_Call_Frame warning(int line = __builtin_LINE()) { return {LL_WARN, log_source, line}; }

} // namespace

Value::Type type_of(const Meta_Feature* feature)
{
    if (const Meta_Property* property = to_property(feature))
    {
        const auto scalar = static_cast<Value::Type>(property->type);
        return is_array(property) ? Value::array_of(scalar) : scalar;
    }
    if (is_reference(feature))
        return is_array(as_reference(feature)) ? Value::INSTANCE_ARRAY : Value::INSTANCE;
    return Value::NONE;
}

Value::Value(const Value& x) : _type(x._type), _null(x._null), _content(x._content) { Value_Access::ref_all(_content); }

Value::Value(Value&& x) noexcept : _type(x._type), _null(x._null), _content(std::move(x._content))
{
    // What was moved out must not be released twice.
    x._content = std::monostate();
    x.clear();
}

Value& Value::operator=(Value x) noexcept
{
    std::swap(_type, x._type);
    std::swap(_null, x._null);
    std::swap(_content, x._content);
    return *this;
}

void Value::clear() noexcept
{
    Value_Access::unref_all(_content);
    _content = std::monostate();
    _type = NONE;
    _null = true;
}

void Value::adopt(Content&& content) noexcept
{
    clear();
    _content = std::move(content);
    _type = Value_Access::type_at(_content.index());
    _null = false;
}

void Value::set_null(Type type)
{
    adopt(Value_Access::content_at(type, nullptr));
    _null = true;
}

int Value::set(const Instance* instance, const Meta_Feature* feature)
{
    check_inst(instance);
    const Type type = type_of(feature);
    if (type == NONE)
    {
        clear();
        return -1;
    }

    // Everything is read and referenced before adopt() may release the instance it is read from.
    bool null = false;
    Content content;
    if (const Meta_Property* property = to_property(feature))
    {
        content = Value_Access::content_at(type, address_of(instance, property->offset));
        null = null_of(instance, property) != 0;
    }
    else if (const Meta_Reference* array = to_array_reference(feature))
    {
        content = references_of(instance, array);
        null = null_of(instance, array) != 0;
    }
    else
    {
        auto* referenced = const_cast<Instance*>(reference_of(instance, as_reference(feature)));
        content = referenced;
        null = !referenced;
    }
    Value_Access::ref_all(content);
    adopt(std::move(content));
    _null = null;
    return 0;
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

int store_reference(Instance* referenced, Instance* instance, const Meta_Reference* reference)
{
    if (!check_class(referenced, instance, reference))
        return -1;
    ref(referenced);
    unref(std::exchange(reference_of(instance, reference), referenced));
    return 0;
}

int store_references(const Array<Instance*>& referenced, Instance* instance, const Meta_Reference* reference)
{
    for (const Instance* element : referenced)
        if (!check_class(element, instance, reference))
            return -1;

    Instance_Array stored;
    for (Instance* element : referenced)
    {
        ref(element);
        stored.adopt(Ref<Instance>(element));
    }
    std::swap(references_of(instance, reference), static_cast<Array<Instance*>&>(stored));
    return 0;
}

} // namespace

int Value::get(Instance* instance, const Meta_Feature* feature) const
{
    if (!instance)
    {
        warning().invoke("null instance argument");
        return -1;
    }
    check_inst(instance);
    if (_type == NONE || _type != type_of(feature))
    {
        warning().invoke("type mismatch: %s.%s", record_of(instance)->name, feature->name);
        return -1;
    }

    if (const Meta_Property* property = to_property(feature))
    {
        Value_Access::store_at(_content, address_of(instance, property->offset));
        null_of(instance, property) = _null ? 1 : 0;
        return 0;
    }
    if (const Meta_Reference* single = to_single_reference(feature))
        return store_reference(_null ? nullptr : *get_if<Instance*>(), instance, single);

    const Meta_Reference* array = as_reference(feature);
    if (store_references(*get_if<Array<Instance*>>(), instance, array) != 0)
        return -1;
    null_of(instance, array) = _null ? 1 : 0;
    return 0;
}

} // namespace zmlr
