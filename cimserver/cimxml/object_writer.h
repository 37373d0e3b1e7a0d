// Writes paths and instances (DSP0201, DSP0203).
//
// Null properties stand without a value, and so does a property whose value clients could refuse (value_text.h). Not written
// at all: null keys, arrays of references (there is no element for them) and values of no known type.
#pragma once

#include "cimserver/cimxml/xml_writer.h"
#include "cimserver/model/values.h"
#include "runtime/meta.h"

namespace cimserver
{

// INSTANCENAME: the class name and the keys.
void write_instance_name(Xml_Writer& writer, const Object_Path& path);

// VALUE.REFERENCE around the fullest form that the path has: INSTANCEPATH, LOCALINSTANCEPATH or INSTANCENAME.
void write_reference(Xml_Writer& writer, const Object_Path& path);

// INSTANCE. With a class, each property carries its CLASSORIGIN.
void write_instance(Xml_Writer& writer, const Instance& instance, const zmlr::Meta_Class* origins = nullptr);

// INSTANCEPATH. A path that names no host is on this one.
void write_instance_path(Xml_Writer& writer, const Object_Path& path);

// VALUE.OBJECTWITHPATH: INSTANCEPATH and INSTANCE.
void write_object_with_path(Xml_Writer& writer, const Instance& instance, const zmlr::Meta_Class* origins);

// VALUE or VALUE.ARRAY of anything but references; nothing for a null value and for one that cannot be sent.
void write_value(Xml_Writer& writer, const Value& value);

// The same, and VALUE.REFERENCE or VALUE.REFARRAY for references.
void write_any_value(Xml_Writer& writer, const Value& value);
bool can_be_sent(const Value& value); // whether that writes anything

// PARAMVALUE with the type; nothing for a value that cannot be sent.
void write_output_parameter(Xml_Writer& writer, const Named_Value& parameter);

} // namespace cimserver
