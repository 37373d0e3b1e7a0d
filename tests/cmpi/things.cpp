#include "tests/cmpi/things.h"

namespace test
{

Ref<TST_Thing> thing(const char* name)
{
    Ref<TST_Thing> result(TST_Thing::create());
    result->Name.set(name);
    return result;
}

Ref<TST_Thing> full_thing(const char* name)
{
    Ref<TST_Thing> t = thing(name);
    t->Caption.set("a thing");
    t->BooleanValue.set(true);
    t->Uint8Value.set(0xFF);
    t->Sint8Value.set(-0x80);
    t->Uint16Value.set(0xFFFF);
    t->Sint16Value.set(-0x8000);
    t->Uint32Value.set(0xFFFFFFFF);
    t->Sint32Value.set(-0x7FFFFFFF - 1);
    t->Uint64Value.set(0xFFFFFFFFFFFFFFFF);
    t->Sint64Value.set(-0x7FFFFFFFFFFFFFFF - 1);
    t->Real32Value.set(0.1F);
    t->Real64Value.set(-1.5e300);
    t->Char16Value.set(char16(0x20AC));
    t->DatetimeValue.set(Datetime(90 * Datetime::MIN + 7));
    t->BooleanValues.set({true, false, true});
    t->Uint8Values.set({0, 0xFF});
    t->Sint64Values.set({-1});
    t->Char16Values.set({char16('a'), char16(0xFFFF)});
    t->StringValues.set({"", "one", "zw\xC3\xB6lf"});
    t->DatetimeValues.set({Datetime(), Datetime(Datetime::DAY)});
    return t;
}

Ref<TST_Pair> linked(const char* antecedent, const char* dependent)
{
    Ref<TST_Pair> result(TST_Pair::create());
    result->Antecedent = thing(antecedent).steal();
    result->Dependent = thing(dependent).steal();
    return result;
}

} // namespace test
