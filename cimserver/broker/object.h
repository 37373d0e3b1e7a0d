// What all broker objects share: a CMPI handle {hdl, ft} in front, an owner behind, and the shell of every table function.
//
// An object made while a request (or an attached thread) runs belongs to that request's Arena and is freed with it, as
// providers expect of a broker; release() frees it earlier. A clone belongs to nobody but its caller, who releases it. An
// object belongs to the thread that made it: only clones may be handed to other threads.
#pragma once

#include <cmpift.h>

#include <cstddef>
#include <type_traits>
#include <utility>

namespace cimserver
{

class Arena;

class Object
{
public:
    virtual ~Object() { unlink(); }
    Object& operator=(const Object&) = delete;

    // Whether an arena will free the object.
    bool owned() const { return _next != this; }

protected:
    Object() = default;
    Object(const Object&) {} // the copy has no owner

private:
    friend class Arena;

    void unlink();

    Object* _next = this;
    Object* _previous = this;
};

// Owns the objects that its thread makes from its construction to its destruction. Arenas of one thread nest: an up-call
// that comes back into the module has its own.
class Arena
{
public:
    Arena();
    ~Arena();
    Arena(const Arena&) = delete;
    Arena& operator=(const Arena&) = delete;

    static Arena* current(); // the calling thread's innermost one; null when it has none

    void adopt(Object& object);
    void clear(); // frees every object

private:
    struct Head : Object
    {
    };

    Head _head;
    Arena* _outer;
};

// The base of an object type T behind the CMPI handle `Face_Type`; T has the function table as T::table.
template <class Face_Type, class T> class Handle : public Object
{
public:
    using Face = Face_Type;
    using Table = std::remove_cv_t<std::remove_pointer_t<decltype(Face::ft)>>;

    Handle() : _face{this, const_cast<Table*>(&T::table)} {}
    Handle(const Handle& x) : Object(x), _face{this, const_cast<Table*>(&T::table)} {}

    Face* face() { return &_face; }

private:
    Face _face;
};

// A new object, owned by the thread's arena if there is one.
template <class T, class... Arguments> T& make(Arguments&&... arguments)
{
    T* object = new T(std::forward<Arguments>(arguments)...);
    if (Arena* arena = Arena::current())
        arena->adopt(*object);
    return *object;
}

// What the body of a table function throws to answer a return code.
struct Failure
{
    CMPIrc rc;
};

// The object behind a handle. Throws INVALID_HANDLE for a null handle and for one that is no T of this broker.
template <class T> T& object(const typename T::Face* face)
{
    if (!face || !face->hdl || face->ft != &T::table)
        throw Failure{CMPI_RC_ERR_INVALID_HANDLE};
    return *static_cast<T*>(static_cast<Handle<typename T::Face, T>*>(face->hdl));
}

// A name or text argument that must be there.
inline const char* required(const char* text)
{
    if (!text)
        throw Failure{CMPI_RC_ERR_INVALID_PARAMETER};
    return text;
}

// The shells of table functions: no exception leaves them.
template <class Body> CMPIStatus answer(Body body) noexcept
{
    try
    {
        body();
        return {CMPI_RC_OK, nullptr};
    }
    catch (const Failure& failure)
    {
        return {failure.rc, nullptr};
    }
    catch (...)
    {
        return {CMPI_RC_ERR_FAILED, nullptr};
    }
}

template <class Result, class Body> Result answer(CMPIStatus* status, Result on_failure, Body body) noexcept
{
    Result result = on_failure;
    const CMPIStatus outcome = answer([&] { result = body(); });
    if (status)
        *status = outcome;
    return result;
}

// A new object behind the handle that a table function answers; null when a body throws.
template <class T, class Body> typename T::Face* answer_new(CMPIStatus* status, Body arguments) noexcept
{
    return answer<typename T::Face*>(status, nullptr, [&] { return make<T>(arguments()).face(); });
}

// Data that is not there, which goes with a status other than OK.
inline CMPIData no_data() { return {CMPI_null, CMPI_notFound, {.uint64 = 0}}; }

// The first two functions of every table.
template <class T> CMPIStatus release(typename T::Face* face) noexcept
{
    return answer([&] { delete &object<T>(face); });
}

template <class T> typename T::Face* clone(const typename T::Face* face, CMPIStatus* status) noexcept
{
    return answer<typename T::Face*>(status, nullptr, [&] { return (new T(object<T>(face)))->face(); });
}

} // namespace cimserver
