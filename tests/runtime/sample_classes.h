// Objects of the runtime's classes in tests/e2e/module/test.mof.
#pragma once

#include "schema/Sample_Disk.h"
#include "schema/Sample_Element.h"
#include "schema/Sample_Limits.h"
#include "schema/Sample_Link.h"
#include "schema/Sample_Person.h"
#include "schema/Sample_Setting.h"

namespace sample
{

using namespace zmlr;

template <class T = Sample_Element> Ref<T> element(const char* name)
{
    Ref<T> result(T::create());
    result->Name.set(name);
    return result;
}
inline Ref<Sample_Disk> disk(const char* name) { return element<Sample_Disk>(name); }

// Takes over both references.
inline Ref<Sample_Link> linked(Ref<Sample_Element> antecedent, Ref<Sample_Disk> dependent)
{
    Ref<Sample_Link> result(Sample_Link::create());
    result->Antecedent = antecedent.steal();
    result->Dependent = dependent.steal();
    return result;
}

// A parameter record with a reference and with an array of them, which it takes over.
inline Ref<Sample_Element_Reset_method> reset_of(Ref<Sample_Element> peer, std::initializer_list<Instance*> others)
{
    Ref<Sample_Element_Reset_method> result(
        static_cast<Sample_Element_Reset_method*>(create(&Sample_Element_Reset_method::static_meta_class)));
    result->Peer = peer.steal();
    result->Others.set(others);
    return result;
}

template <class T> const Meta_Property* property(const char* name) { return find_property(&T::static_meta_class, name); }

} // namespace sample
