// Container: a sequence of named CMPI values, and the walk that carries it into an instance and back, feature by feature.
//
// A bad item never fails a whole conversion: it is logged and leaves its feature null (or its item out).
#pragma once

#include "runtime/instance.h"
#include "runtime/value.h"

namespace zmlr
{

class Container
{
public:
    explicit Container(const Meta_Repository* repository) : _repository(repository) {}
    virtual ~Container() = default;
    Container(const Container&) = delete;
    Container& operator=(const Container&) = delete;

    // Each of these answers 0, or -1 and a log line. How many items there are is asked once, before the first of them. An item is
    // fetched with its name, once; its value is that of the fetched one, its name the server's, good until the next is fetched.
    virtual int get_size(uint32& size) = 0;
    virtual int get_name(uint32 index, const char*& name) = 0;
    virtual int get_value(uint32 index, Value::Type expected, Value& value) = 0;   // index: of the name that was got last
    virtual int set_value(const char* name, const Value& value, uint32 flags) = 0; // flags: of the feature

    // Carries the items into `instance`, which is made of meta_class when it is empty: every property that no item names is
    // null. With a mask only features with one of its flags are set. Returns 0, or -1 and `instance` as it was when the server
    // cannot tell how many items there are.
    int convert(const Meta_Class* meta_class, uint32 mask, Ref<Instance>& instance);

    // Carries the non-null properties and references into the container; with a mask only features with one of its flags.
    // Returns 0, or -1 for a null instance.
    int convert(const Instance* instance, uint32 mask);

    // The same for the last time: unless somebody else holds the instance, each property ends when it is in the container, so
    // that the whole of both is never in memory. One that has ended is that of a new record, not null.
    int convert_and_end(const Ref<Instance>& instance, uint32 mask);

protected:
    const Meta_Repository* repository() const { return _repository; }

private:
    template <class Done> int carry(const Instance* instance, uint32 mask, Done done);

    const Meta_Repository* _repository;
};

} // namespace zmlr
