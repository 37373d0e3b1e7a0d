// Writes classes from the module's meta-data (DSP0201, DSP0203).
#pragma once

#include "cimserver/cimxml/xml_writer.h"
#include "cimserver/model/values.h"
#include "runtime/meta.h"

namespace cimserver
{

// What a client asked to see of a class (DSP0200, GetClass).
struct Class_Selection
{
    bool local_only = true; // only features that the class itself declares or overrides
    bool qualifiers = true;
    bool class_origin = false;
    Property_List properties; // of properties and references; methods are always there
};

// CLASS: qualifiers, properties and references in declaration order, methods. Arrays of references are left out of the
// properties: there is no element for them.
void write_class(Xml_Writer& writer, const zmlr::Meta_Class& meta_class, const Class_Selection& selection);

} // namespace cimserver
