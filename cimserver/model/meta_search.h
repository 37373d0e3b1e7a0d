// Where the features of a class come from. Works on the plain meta-data records, without the module's own functions.
#pragma once

#include "runtime/meta.h"

#include <span>
#include <string_view>

namespace cimserver
{

inline std::span<const zmlr::Meta_Feature* const> features_of(const zmlr::Meta_Record& record)
{
    return {record.meta_features, record.num_meta_features};
}

// The index of a feature in the list of a class or of a parameter in that of a method, num_meta_features when it has none of
// that name; and the feature itself, null when there is none.
unsigned feature_index(const zmlr::Meta_Record& record, std::string_view name);
const zmlr::Meta_Feature* find_feature(const zmlr::Meta_Record& record, std::string_view name);

// The property or reference (of a method: the parameter) of that name; null when there is none.
const zmlr::Meta_Feature* find_value(const zmlr::Meta_Record& record, std::string_view name);

// Whether the class itself declares or overrides its feature at the index.
inline bool is_local(const zmlr::Meta_Class& meta_class, unsigned index) { return meta_class.locals[index].local != 0; }

// The class that introduces a feature: the farthest ancestor that has it. Null when the class has no such feature.
const zmlr::Meta_Class* origin_of(const zmlr::Meta_Class& meta_class, std::string_view feature);

// The class whose words describe a feature: that which declares it or last overrides it. Null when the class has no such
// feature.
const zmlr::Meta_Class* describing_class_of(const zmlr::Meta_Class& meta_class, std::string_view feature);

} // namespace cimserver
