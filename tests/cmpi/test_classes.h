// Classes with meta-data written by hand: a Test_Thing with a property of every type, a Test_Disk derived from it that has
// methods, a Test_Link that associates two things, a Test_Alert. Their instances are counted.
#pragma once

#include "runtime/instance.h"

#include <utility>

namespace test
{

using namespace zmlr;

struct Test_Thing : Instance
{
    Property<String> Name; // key
    Property<boolean> Boolean;
    Property<uint8> Uint8;
    Property<sint8> Sint8;
    Property<uint16> Uint16;
    Property<sint16> Sint16;
    Property<uint32> Uint32;
    Property<sint32> Sint32;
    Property<uint64> Uint64;
    Property<sint64> Sint64;
    Property<real32> Real32;
    Property<real64> Real64;
    Property<char16> Char16;
    Property<Datetime> When;
    Property<Array<boolean>> Booleans;
    Property<Array<uint8>> Uint8s;
    Property<Array<sint64>> Sint64s;
    Property<Array<char16>> Char16s;
    Property<Array<String>> Strings;
    Property<Array<Datetime>> Whens;

    static Meta_Class static_meta_class;
};

struct Test_Disk : Test_Thing
{
    static Meta_Class static_meta_class;
};

// The parameters of Test_Disk's methods: Convert, one of every kind, and the static Reset.
struct Test_Disk_Convert_method : Instance
{
    Property<uint8> Level;             // in
    Property<Array<String>> Texts;     // in
    Test_Thing* Partner;               // in
    Property<Array<Instance*>> Others; // in, references
    Property<sint64> Count;            // in and out
    Property<String> Answer;           // out
    Property<Array<uint16>> Numbers;   // out
    Test_Thing* Found;                 // out
    Property<String> return_value;

    static const Meta_Method static_meta_class;
};

struct Test_Disk_Reset_method : Instance
{
    Property<uint32> return_value;

    static const Meta_Method static_meta_class;
};

struct Test_Link : Instance
{
    Test_Thing* Antecedent; // key
    Test_Thing* Dependent;  // key
    Property<String> Note;
    Test_Thing* Detail;                 // embedded
    Property<Array<Instance*>> Others;  // references
    Property<Array<Instance*>> Details; // embedded

    static Meta_Class static_meta_class;
};

struct Test_Alert : Instance
{
    Property<String> Message;
    Property<Array<String>> Texts;

    static Meta_Class static_meta_class;
};

// A class that no generator writes: its one feature is neither property nor reference nor method.
struct Test_Odd : Instance
{
    Instance* Odd;

    static Meta_Class static_meta_class;
};

extern const Meta_Repository repository;

Ref<Test_Thing> thing(const char* name);
Ref<Test_Thing> full_thing(const char* name); // every property has a value
Ref<Test_Link> make_link(const char* antecedent, const char* dependent);

// Instances alive, of all classes.
unsigned live_instances();

} // namespace test
