#include "cimserver/operations/typed_objects.h"

#include "cimserver/model/meta_search.h"
#include "cimserver/model/operations.h"
#include "cimserver/model/paths.h"
#include "cimserver/model/repository.h"
#include "cimserver/model/value_reader.h"
#include "cimserver/model/value_text.h"
#include "cimserver/operations/typed_keys.h"

namespace cimserver
{
namespace
{

std::string described(CMPIType type) { return std::string((type & CMPI_ARRAY) != 0 ? "array of " : "") + cim_type_name(type); }

class Converter
{
public:
    Converter(const Repository& repository, const std::string& name_space) : _repository(repository), _name_space(name_space) {}

    // The value for a feature, null when it is null. Throws Type_Error.
    Value value(const zmlr::Meta_Feature& feature, const Value& given)
    {
        const CMPIType type = cmpi_type(feature);
        Value result{type, {}};
        if (given.null())
            return result;
        result.content = (type & CMPI_ARRAY) != 0 ? array(feature, given) : scalar(feature, type, given);
        if (result.null())
            throw Type_Error("the value of " + std::string(feature.name) + " is no " + described(type));
        return result;
    }

    std::vector<Named_Value> properties(const Class_Entry& entry, const std::vector<Named_Value>& given, int unknown_property)
    {
        std::vector<Named_Value> result;
        for (const Named_Value& property : given)
        {
            const zmlr::Meta_Feature* feature = find_value(*entry.meta_class, property.name);
            if (!feature)
                throw Cim_Error(unknown_property,
                                "class " + std::string(entry.meta_class->name) + " has no property " + property.name.string());
            if (find_named(given, property.name) != &property)
                throw Type_Error("property given twice: " + property.name.string());
            result.push_back({feature->name, value(*feature, property.value)});
        }
        return result;
    }

private:
    Value::Content scalar(const zmlr::Meta_Feature& feature, CMPIType type, const Value& given)
    {
        if (type == CMPI_ref)
            return typed_reference(_repository, *zmlr::as_reference(&feature), given, _name_space);
        return scalar_content(given, type);
    }

    // Null when one element is none of the type; an element that is null stays so.
    Value::Content array(const zmlr::Meta_Feature& feature, const Value& given)
    {
        const auto* elements = given.as<std::vector<Value>>();
        if (!elements)
            return {};
        const CMPIType type = element_of(cmpi_type(feature));
        std::vector<Value> result;
        result.reserve(elements->size());
        for (const Value& element : *elements)
        {
            result.push_back({type, element.null() ? Value::Content() : scalar(feature, type, element)});
            if (!element.null() && result.back().null())
                return {};
        }
        return result;
    }

    const Repository& _repository;
    const std::string& _name_space;
};

std::vector<Named_Value> keys_among(const Class_Entry& entry, const std::vector<Named_Value>& properties)
{
    std::vector<Named_Value> keys;
    for (std::size_t place = 0; place < entry.layout->size(); ++place)
        if (const Named_Value* key = entry.layout->is_key(place) ? find_named(properties, (*entry.layout)[place].name) : nullptr;
            key && !key->value.null())
            keys.push_back(*key);
    return keys;
}

// An instance that has a path has its keys among its properties, too, and keeps them.
void add_keys(Instance& instance)
{
    for (const Named_Value& key : instance.path.keys)
    {
        const Value* property = instance.properties.find(key.name);
        if (!property)
            instance.properties.put(key.name, key.value);
        else if (path_identity({"", "", "", {{key.name, *property}}}) != path_identity({"", "", "", {key}}))
            throw Cim_Error(CIM_ERR_INVALID_PARAMETER, "the key " + key.name.string() + " cannot be changed");
    }
}

} // namespace

Instance typed_instance(const Repository& repository, const Class_Entry& entry, const Instance& instance, int unknown_property)
{
    Instance result{{{}, instance.path.name_space, entry.name, {}}, {}};
    Converter converter(repository, result.path.name_space);
    result.properties = converter.properties(entry, instance.properties, unknown_property);
    if (instance.path.keys.empty())
    {
        result.path.keys = keys_among(entry, result.properties);
        return result;
    }
    result.path.keys = typed_keys(repository, entry, instance.path);
    add_keys(result);
    return result;
}

std::vector<Named_Value> typed_arguments(const Repository& repository, const zmlr::Meta_Method& method,
                                         const std::vector<Named_Value>& in, const std::string& name_space)
{
    const auto refuse = [&](const std::string& reason, const std::string& parameter)
    { throw Type_Error("method " + std::string(method.name) + ": " + reason + ": " + parameter); };

    for (const Named_Value& argument : in)
    {
        const zmlr::Meta_Feature* parameter = find_value(method, argument.name);
        if (!parameter || (parameter->flags & zmlr::Flag_In) == 0)
            refuse("it has no such input parameter", argument.name);
        if (find_named(in, argument.name) != &argument)
            refuse("parameter given twice", argument.name);
    }

    Converter converter(repository, name_space);
    std::vector<Named_Value> result;
    for (const zmlr::Meta_Feature* parameter : features_of(method))
        if (const Named_Value* argument = find_named(in, parameter->name))
            result.push_back({parameter->name, converter.value(*parameter, argument->value)});
    return result;
}

} // namespace cimserver
