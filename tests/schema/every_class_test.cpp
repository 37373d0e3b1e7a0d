// Every class of the repository, and every parameter record, through every generic operation: laws that hold whatever the
// features are.
#include "runtime/features.h"
#include "runtime/model_path.h"
#include "tests/schema/repository_classes.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cstring>
#include <string>
#include <type_traits>

namespace zmlr
{
namespace
{

// The value of number n: another one than n + 1 has.
template <class T> T numbered(unsigned n)
{
    if constexpr (std::is_same_v<T, String>)
        return String(("text " + std::to_string(n)).c_str());
    else if constexpr (std::is_same_v<T, Datetime>)
        return Datetime(n * Datetime::SEC);
    else if constexpr (std::is_same_v<T, boolean>)
        return n % 2 == 1;
    else if constexpr (std::is_same_v<T, char16>)
        return char16(static_cast<uint16>(n));
    else if constexpr (std::is_floating_point_v<T>)
        return static_cast<T>(n) + T{0.5};
    else
        return static_cast<T>(n);
}

template <class T> void set_as(Instance* instance, const Meta_Property* property, unsigned n)
{
    if (is_array(property))
        value_at<Array<T>>(instance, property->offset) = {numbered<T>(n), numbered<T>(n + 1)};
    else
        value_at<T>(instance, property->offset) = numbered<T>(n);
    null_of(instance, property) = 0;
}

void set(Instance* instance, const Meta_Property* property, unsigned n)
{
    constexpr void (*setters[num_types])(Instance*, const Meta_Property*, unsigned) = {
        set_as<boolean>, set_as<uint8>,  set_as<sint8>,  set_as<uint16>, set_as<sint16>, set_as<uint32>, set_as<sint32>,
        set_as<uint64>,  set_as<sint64>, set_as<real32>, set_as<real64>, set_as<char16>, set_as<String>, set_as<Datetime>,
    };
    setters[property->type](instance, property, n);
}

// An instance with every feature set to the value of its position and the seed: inherited features are equal in all classes.
Ref<Instance> filled(const Meta_Record* record, unsigned seed)
{
    Ref<Instance> result(is_method(record) ? create(static_cast<const Meta_Method*>(record))
                                           : create(static_cast<const Meta_Class*>(record), false));
    result->__name_space = "root/zemlar";
    for (const Meta_Feature* feature : features_of(record))
    {
        ++seed;
        if (const Meta_Property* property = to_property(feature))
            set(result.ptr(), property, seed);
        else if (const Meta_Reference* single = to_single_reference(feature))
            reference_of(result.ptr(), single) = filled(single->meta_class, seed).steal();
        else if (const Meta_Reference* array = to_array_reference(feature))
        {
            references_of(result.ptr(), array) = {filled(array->meta_class, seed).steal(), nullptr};
            null_of(result.ptr(), array) = 0;
        }
    }
    return result;
}

Ref<Instance> cloned(const Ref<Instance>& instance) { return Ref<Instance>(clone(static_cast<const Instance*>(instance.ptr()))); }

void for_each_class(void (*law)(const Meta_Class*))
{
    ASSERT_EQ(repository_classes().size(), 177U);
    for (const Meta_Class* meta_class : repository_classes())
    {
        SCOPED_TRACE(meta_class->name);
        law(meta_class);
    }
}

// A record of each class and of each method's parameters, where the method is declared.
void for_each_record(void (*law)(const Meta_Record*))
{
    for (const Meta_Class* meta_class : repository_classes())
    {
        SCOPED_TRACE(meta_class->name);
        law(meta_class);
        for (uint32 i = 0; i < meta_class->num_meta_features; ++i)
            if (meta_class->locals[i].local && is_method(meta_class->meta_features[i]))
                law(as_method(meta_class->meta_features[i]));
    }
}

bool feature_eq(const Meta_Feature* feature, const Instance* a, const Instance* b)
{
    if (const Meta_Property* property = to_property(feature))
        return property_eq(property, a, b);
    const Meta_Reference* reference = to_single_reference(feature);
    if (!reference)
        return true;
    const Instance* at_a = reference_of(a, reference);
    const Instance* at_b = reference_of(b, reference);
    return at_a && at_b ? identical(at_a, at_b) : at_a == at_b;
}

bool has_default(const Instance* instance, const Meta_Property* property)
{
    const uint32 at = property->offset;
    if (is_array(property))
        return value_at<Array<uint8>>(instance, at).size() == property->value->size;
    if (property->type == STRING)
        return value_at<String>(instance, at) == static_cast<const char*>(property->value->data);
    if (property->type == DATETIME)
        return value_at<Datetime>(instance, at).ascii() == static_cast<const char*>(property->value->data);
    return std::memcmp(address_of(instance, at), property->value->data, type_size[property->type]) == 0;
}

void expect_defaults_or_zeros(const Meta_Class* meta_class)
{
    const Ref<Instance> made(create(meta_class, true));
    const Ref<Instance> zero(create(meta_class, false));
    const Ref<Instance> cleared = filled(meta_class, 1);
    clear(cleared.ptr());
    for (const Meta_Feature* feature : features_of(meta_class))
    {
        if (const Meta_Property* property = to_property(feature))
        {
            EXPECT_EQ(null_of(made.ptr(), property), property->value ? 0 : 1) << feature->name;
            EXPECT_TRUE(!property->value || has_default(made.ptr(), property)) << feature->name;
            EXPECT_EQ(null_of(zero.ptr(), property), 0) << feature->name;
            EXPECT_EQ(null_of(cleared.ptr(), property), 1) << feature->name;
        }
    }
    de_nullify_properties(cleared.ptr());
    EXPECT_TRUE(identical(cleared.ptr(), zero.ptr()));
}

TEST(Every_Class, starts_with_its_defaults_or_with_zeros_and_is_cleared_to_zeros) { for_each_class(expect_defaults_or_zeros); }

// Changes one feature of b, sees that each way of being different counts (or not), and undoes it.
void expect_change_seen(const Meta_Feature* feature, unsigned n, bool (*equal)(const Instance*, const Instance*), bool seen,
                        const Instance* a, Instance* b)
{
    SCOPED_TRACE(feature->name);
    if (const Meta_Property* property = to_property(feature))
    {
        set(b, property, n + 1);
        EXPECT_FALSE(property_eq(property, a, b));
        EXPECT_EQ(equal(a, b), !seen);
        set(b, property, n);
        null_of(b, property) = 1;
        EXPECT_EQ(equal(a, b), !seen);
        null_of(b, property) = 0;
    }
    if (const Meta_Reference* reference = to_single_reference(feature))
    {
        Instance*& slot = reference_of(b, reference);
        EXPECT_NE(slot, reference_of(a, reference));
        Instance* target = std::exchange(slot, nullptr);
        EXPECT_EQ(equal(a, b), !seen);
        slot = target;
    }
    EXPECT_TRUE(equal(a, b));
}

void expect_identical_clone(const Meta_Record* record)
{
    const Ref<Instance> original = filled(record, 1);
    const Ref<Instance> copied = cloned(original);
    EXPECT_EQ(Atomic_get(&copied->__refs), 1U);
    ASSERT_TRUE(identical(original.ptr(), copied.ptr()));
    unsigned n = 1;
    for (const Meta_Feature* feature : features_of(record))
        expect_change_seen(feature, ++n, identical, true, original.ptr(), copied.ptr());
}

TEST(Every_Class, a_clone_is_identical_until_anything_of_it_changes) { for_each_record(expect_identical_clone); }

void expect_keys_decide(const Meta_Class* meta_class)
{
    const Ref<Instance> a = filled(meta_class, 1);
    const Ref<Instance> b = cloned(a);
    unsigned n = 1;
    for (const Meta_Feature* feature : features_of(meta_class))
        expect_change_seen(feature, ++n, key_eq, is_key(feature), a.ptr(), b.ptr());
    if (const Meta_Class* superclass = meta_class->super_meta_class)
    {
        EXPECT_TRUE(key_eq(filled(superclass, 1).ptr(), a.ptr()));
    }
}

TEST(Every_Class, only_keys_decide_whether_two_objects_are_one) { for_each_class(expect_keys_decide); }

// A model in which every second feature is set.
Ref<Instance> half_set_model(const Ref<Instance>& source)
{
    Ref<Instance> model = cloned(source);
    nullify_properties(model.ptr());
    bool wanted = false;
    for (const Meta_Feature* feature : features_of(model->meta_class))
    {
        wanted = !wanted;
        const Meta_Reference* reference = to_single_reference(feature);
        if (const Meta_Property* property = to_property(feature))
            null_of(model.ptr(), property) = wanted ? 0 : 1;
        else if (reference && !wanted)
            unref(std::exchange(reference_of(model.ptr(), reference), nullptr));
    }
    return model;
}

void expect_copies(const Meta_Class* meta_class)
{
    const Ref<Instance> source = filled(meta_class, 1), old = filled(meta_class, 2);
    const Ref<Instance> all = cloned(old), some = cloned(old), keys = cloned(old);
    copy(all.ptr(), source.ptr());
    copy(some.ptr(), source.ptr(), half_set_model(source).ptr());
    copy_keys(keys.ptr(), source.ptr());
    const Ref<Instance> key_copy(key_clone(source.ptr()));
    const Ref<Instance> bare(create(meta_class, false));
    nullify_properties(bare.ptr());

    bool wanted = false;
    for (const Meta_Feature* feature : features_of(meta_class))
    {
        SCOPED_TRACE(feature->name);
        wanted = !wanted;
        EXPECT_TRUE(feature_eq(feature, all.ptr(), source.ptr()));
        EXPECT_TRUE(feature_eq(feature, some.ptr(), (wanted ? source : old).ptr()));
        EXPECT_TRUE(feature_eq(feature, keys.ptr(), (is_key(feature) ? source : old).ptr()));
        EXPECT_TRUE(feature_eq(feature, key_copy.ptr(), (is_key(feature) ? source : bare).ptr()));
    }
}

TEST(Every_Class, copies_take_what_they_are_told_and_leave_the_rest) { for_each_class(expect_copies); }

void expect_null_flags(const Meta_Class* meta_class)
{
    const bool has_key_property =
        std::ranges::any_of(features_of(meta_class), [](auto f) { return is_property(f) && is_key(f); });
    const Ref<Instance> original = filled(meta_class, 1);
    const Ref<Instance> instance = cloned(original), filtered = cloned(original);
    nullify_non_keys(instance.ptr());
    const char* const nothing[] = {"NoSuchName", nullptr};
    EXPECT_EQ(filter_properties(filtered.ptr(), nothing, true), 0);
    EXPECT_TRUE(identical(filtered.ptr(), instance.ptr()));
    EXPECT_TRUE(keys_non_null(instance.ptr()));
    for (const Meta_Feature* feature : features_of(meta_class))
    {
        if (const Meta_Property* property = to_property(feature))
        {
            EXPECT_EQ(null_of(instance.ptr(), property) == 0, is_key(feature)) << feature->name;
        }
        else
        {
            EXPECT_TRUE(feature_eq(feature, filtered.ptr(), original.ptr())) << "a reference survives";
        }
    }
    nullify_properties(instance.ptr());
    EXPECT_EQ(keys_non_null(instance.ptr()), !has_key_property);
    EXPECT_EQ(filter_properties(instance.ptr(), nullptr, true), 0);
    EXPECT_TRUE(identical(instance.ptr(), original.ptr())) << "values stay behind their flags";

    const Ref<Instance> bare(create(meta_class, false));
    EXPECT_EQ(keys_non_null(bare.ptr()), meta_class->num_keys == 0 || has_key_property);
    __create_refs(bare.ptr());
    EXPECT_TRUE(keys_non_null(bare.ptr()));
}

TEST(Every_Class, null_flags_hide_values_and_keep_them) { for_each_class(expect_null_flags); }

// Whether the class and those that its keys refer to have keys.
bool has_path(const Meta_Class* meta_class)
{
    return meta_class->num_keys > 0 &&
           std::ranges::all_of(features_of(meta_class), [](const Meta_Feature* f)
                               { return !is_key(f) || !is_reference(f) || has_path(as_reference(f)->meta_class); });
}

void expect_no_path_without(const Meta_Feature* key, const Ref<Instance>& instance)
{
    const Ref<Instance> broken = cloned(instance);
    if (const Meta_Property* property = to_property(key))
        null_of(broken.ptr(), property) = 1;
    else
        unref(std::exchange(reference_of(broken.ptr(), as_reference(key)), nullptr));
    String path;
    EXPECT_EQ(instance_to_model_path(broken.ptr(), path), -1) << key->name;
}

void expect_path_and_back(const Meta_Class* meta_class)
{
    const Ref<Instance> instance = filled(meta_class, 1);
    String path, again;
    ASSERT_EQ(instance_to_model_path(instance.ptr(), path), has_path(meta_class) ? 0 : -1);
    if (!has_path(meta_class))
        return;

    const Ref<Instance> read(model_path_to_instance(meta_class, path.c_str()));
    ASSERT_TRUE(read) << path.c_str();
    const Ref<Instance> keys(key_clone(instance.ptr()));
    EXPECT_TRUE(key_eq(read.ptr(), keys.ptr()));
    EXPECT_EQ(instance_to_model_path(read.ptr(), again), 0);
    EXPECT_EQ(again, path);
    for (const Meta_Feature* feature : features_of(meta_class))
    {
        if (const Meta_Property* property = to_property(feature))
        {
            EXPECT_EQ(null_of(read.ptr(), property), null_of(keys.ptr(), property)) << feature->name;
        }
        if (is_key(feature))
            expect_no_path_without(feature, instance);
    }
}

TEST(Every_Class, a_path_reads_back_to_the_keys) { for_each_class(expect_path_and_back); }

} // namespace
} // namespace zmlr
