#include "cimserver/broker/object.h"

namespace cimserver
{
namespace
{

thread_local Arena* current_arena = nullptr;

} // namespace

void Object::unlink()
{
    _previous->_next = _next;
    _next->_previous = _previous;
    _next = _previous = this;
}

Arena::Arena() : _outer(current_arena) { current_arena = this; }

Arena::~Arena()
{
    clear();
    current_arena = _outer;
}

Arena* Arena::current() { return current_arena; }

void Arena::adopt(Object& object)
{
    object._previous = _head._previous;
    object._next = &_head;
    _head._previous->_next = &object;
    _head._previous = &object;
}

void Arena::clear()
{
    while (_head.owned())
        delete _head._next;
}

} // namespace cimserver
