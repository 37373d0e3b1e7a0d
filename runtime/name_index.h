// The side index of a repository: how a class or a feature is found by its name without comparing every name.
//
// The meta-data records have fixed fields, so the index lies beside them: constant tables that the generator lists and the
// compiler sorts by a hash of the names. No two classes, and no two features of one record, have the same hash, so that one
// full comparison decides whether a name is there. Only the module's own repository has an index; others are walked.
#pragma once

#include "runtime/ascii.h"
#include "runtime/meta.h"

#include <algorithm>
#include <array>
#include <cstddef>
#include <span>

namespace zmlr
{

// FNV-1a over the lower-case name: the same for all names that eqi() holds equal.
constexpr uint32 name_hash(const char* name)
{
    uint32 hash = 0x811C9DC5;
    for (; *name; ++name)
        hash = (hash ^ ascii::to_lower(*name)) * 0x01000193;
    return hash;
}

struct Feature_Entry
{
    uint32 hash;
    uint32 position; // among the features of the record
};

struct Record_Entry
{
    uint32 hash;
    const Meta_Record* record;
    const Feature_Entry* features; // one per feature of the record
};

struct Repository_Index
{
    const Meta_Repository* repository;
    std::span<const Record_Entry> classes;
    std::span<const Record_Entry> methods; // those of several classes may share a name
};

// Defined beside the module's repository. In a program without that repository the address is null.
[[gnu::weak]] extern const Repository_Index own_repository_index;

// The entries in the order of their hashes.
template <class Entry, std::size_t N> constexpr std::array<Entry, N> by_hash(const Entry (&entries)[N])
{
    std::array<Entry, N> sorted = std::to_array(entries);
    std::ranges::sort(sorted, {}, &Entry::hash);
    return sorted;
}

// The same for names that one comparison must tell apart: two entries with one hash do not compile.
template <class Entry, std::size_t N> consteval std::array<Entry, N> by_distinct_hash(const Entry (&entries)[N])
{
    const std::array<Entry, N> sorted = by_hash(entries);
    if (std::ranges::adjacent_find(sorted, {}, &Entry::hash) != sorted.end())
        throw "two names have the same hash";
    return sorted;
}

// The entry of a class or method, or null when the index does not hold this very record.
const Record_Entry* find_entry(const Meta_Record* record);

// What the index holds under a name, or null.
const Meta_Class* find_meta_class(const Repository_Index& index, const char* name);
const Meta_Feature* find_feature(const Record_Entry& entry, const char* name);

} // namespace zmlr
