// A small repository of classes: what the generator makes of a MOF file, written by hand.
//
//   Sample_Element        key Name; one property of every kind, with and without defaults; method Reset
//   Sample_Disk           a Sample_Element with one more property
//   Sample_Link           an association of two elements (key references), with an array of further elements
//   Sample_Person         unrelated, with a key of the same name
//   Sample_Setting        without keys
#pragma once

#include "runtime/instance.h"

namespace sample
{

using namespace zmlr;

struct Sample_Element : Instance
{
    Property<String> Name; // key
    Property<boolean> Online;
    Property<uint8> Slot;
    Property<uint32> Size; // default 1
    Property<sint64> Delta;
    Property<real64> Load;
    Property<char16> Letter;             // default 'x'
    Property<Datetime> Since;            // default: an interval of a day
    Property<String> Caption;            // default "new element"
    Property<Array<String>> Labels;      // default {"a", "b"}
    Property<Array<uint16>> Codes;       // default {2, 3, 5}
    Property<Array<Datetime>> Intervals; // default: one interval of zero
    Property<Array<real64>> Samples;

    static const Meta_Class static_meta_class;
};

struct Sample_Disk : Sample_Element
{
    Property<uint64> Blocks;

    static const Meta_Class static_meta_class;
};

struct Sample_Link : Instance
{
    Sample_Element* Antecedent; // key
    Sample_Disk* Dependent;     // key
    Property<Array<Instance*>> Others;
    Property<String> Note;

    static const Meta_Class static_meta_class;
};

struct Sample_Person : Instance
{
    Property<String> Name; // key

    static const Meta_Class static_meta_class;
};

struct Sample_Setting : Instance
{
    Property<uint32> Level;

    static const Meta_Class static_meta_class;
};

struct Sample_Element_Reset_method : Instance
{
    Property<uint32> Delay;
    Sample_Element* Peer;
    Property<uint32> return_value;

    static const Meta_Method static_meta_class;
};

extern const Meta_Repository repository;

// Objects with a name, and a link between two of them (which takes over both references).
Ref<Sample_Element> element(const char* name);
Ref<Sample_Disk> disk(const char* name);
Ref<Sample_Link> linked(Ref<Sample_Element> antecedent, Ref<Sample_Disk> dependent);

template <class T> const Meta_Property* property(const char* name) { return find_property(&T::static_meta_class, name); }

} // namespace sample
