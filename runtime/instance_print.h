// The debug text of an instance: a block of its name space, properties and references, indented four spaces a level.
//
//     ZEMLAR_FCPort
//     {
//         string __name_space = "root/zemlar";
//         uint64 Speed = 8000000000;
//         string Caption = NULL;
//     }
#pragma once

#include "runtime/instance.h"

#include <cstdio>

namespace zmlr
{

// Writes the instance, and within it every instance that it references.
void fprint(std::FILE* stream, const Instance* instance);
void print(const Instance* instance); // to standard output

} // namespace zmlr
