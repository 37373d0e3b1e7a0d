// The last step of every enumeration: instances leave the provider.
#pragma once

#include "cmpi/handlers.h"
#include "runtime/instance.h"

namespace zmlr
{

// Hands over each instance of the class (or of a subclass), in order, until the handler has enough. The handler gets the array's
// own reference, and null stays in its place: the instances are new objects that nobody else holds.
template <class T> void deliver(Instance_Array& instances, Enum_Instances_Handler<T>& handler)
{
    for (Instance*& place : instances)
    {
        if (T* instance = cast<T>(place))
        {
            place = nullptr;
            if (!handler.handle(instance))
                return;
        }
    }
}

} // namespace zmlr
