#include "cimserver/operations/typed_keys.h"

#include "cimserver/model/meta_search.h"
#include "cimserver/model/value_reader.h"
#include "cimserver/model/value_text.h"

namespace cimserver
{
namespace
{

// References in references: no class of any schema comes near this depth, a hostile request may.
constexpr int max_depth = 8;

class Key_Converter
{
public:
    explicit Key_Converter(const Repository& repository) : _repository(repository) {}

    std::vector<Named_Value> keys(const Class_Entry& entry, const Object_Path& path)
    {
        if (++_depth > max_depth)
            throw Key_Error("the references in the keys are nested too deeply");

        refuse_unknown_and_repeated(entry, path);
        std::vector<Named_Value> result;
        for (const zmlr::Meta_Feature* feature : features_of(*entry.meta_class))
            if (zmlr::is_key(feature))
                result.push_back({(*entry.layout)[*entry.layout->find(feature->name)].name, converted(entry, *feature, path)});
        --_depth;
        return result;
    }

    // A reference may name the declared class, one derived from it, or a superclass that a client walked in through.
    Value::Content reference_content(const Value& value, const zmlr::Meta_Reference& reference, const std::string& name_space)
    {
        const auto* target = value.as<Object_Path>();
        const Class_Entry* entry = target ? _repository.find(target->class_name) : nullptr;
        if (!entry || !are_related(entry->meta_class, reference.meta_class))
            return {};

        Object_Path result{target->host, target->name_space, entry->name, keys(*entry, *target)};
        if (result.name_space.empty())
            result.name_space = name_space;
        return result;
    }

private:
    [[noreturn]] static void refuse(const std::string& key, const Class_Entry& entry, const std::string& reason)
    {
        throw Key_Error("key " + key + " of class " + std::string(entry.meta_class->name) + ": " + reason);
    }

    static void refuse_unknown_and_repeated(const Class_Entry& entry, const Object_Path& path)
    {
        for (const Named_Value& key : path.keys)
        {
            const auto place = entry.layout->find(key.name);
            if (!place || !entry.layout->is_key(*place))
                refuse(key.name, entry, "there is no such key");
            if (find_named(path.keys, key.name) != &key)
                refuse(key.name, entry, "it is given twice");
        }
    }

    Value converted(const Class_Entry& entry, const zmlr::Meta_Feature& feature, const Object_Path& path)
    {
        const Named_Value* given = find_named(path.keys, feature.name);
        if (!given || given->value.null())
            refuse(feature.name, entry, "it is missing");

        const CMPIType type = cmpi_type(feature);
        Value value{type, type == CMPI_ref ? reference_content(given->value, *zmlr::as_reference(&feature), path.name_space)
                                           : scalar_content(given->value, type)};
        if (value.null())
            refuse(feature.name, entry, std::string("its value is no ") + cim_type_name(type));
        return value;
    }

    const Repository& _repository;
    int _depth = 0;
};

} // namespace

Value::Content typed_reference(const Repository& repository, const zmlr::Meta_Reference& reference, const Value& value,
                               const std::string& name_space)
{
    return Key_Converter(repository).reference_content(value, reference, name_space);
}

std::vector<Named_Value> typed_keys(const Repository& repository, const Class_Entry& entry, const Object_Path& path)
{
    return Key_Converter(repository).keys(entry, path);
}

} // namespace cimserver
