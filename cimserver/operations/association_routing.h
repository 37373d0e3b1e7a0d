// Which association classes a traversal has to ask.
#pragma once

#include "cimserver/model/operations.h"
#include "cimserver/model/repository.h"

#include <vector>

namespace cimserver
{

enum class Ends
{
    source, // References: the result is the association
    both    // Associators: the result is the object at its other end
};

// The served association classes that can concern an instance of `source` and that the filter admits: one reference can name
// the source in the filter's role, and for both ends another one can name the result in its role. Classes match when one is
// the other or derives from it. Throws CIM_ERR_INVALID_PARAMETER for a class of the filter that is not known.
std::vector<const Class_Entry*> concerned_associations(const Repository& classes, const Repository& known,
                                                       const Class_Entry& source, const Association_Filter& filter, Ends ends);

} // namespace cimserver
