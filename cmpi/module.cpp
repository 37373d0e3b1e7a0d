// The module as its loader sees it: the registration list, the static data of every provider, and the factory functions,
// all expanded from providers.def. Everything here is constant-initialised: nothing depends on the order of start-up.
#include "cmpi/entry.h"
#include "cmpi/registration.h"
#include "cmpi/served_classes.h"

#include <cmpift.h>

namespace zmlr
{

// The provider procedures.
#define ZMLR_PROVIDER(Class, interfaces, state)                                                                                  \
    int __cimple_##Class##_Provider_proc(const Registration* registration, int operation, void* arg0, void* arg1, void* arg2,    \
                                         void* arg3, void* arg4, void* arg5, void* arg6, void* arg7);
#include "providers/providers.def"
#undef ZMLR_PROVIDER

namespace
{

enum Index : unsigned
{
#define ZMLR_PROVIDER(Class, interfaces, state) INDEX_##Class,
#include "providers/providers.def"
#undef ZMLR_PROVIDER
    num_providers
};

extern const Registration registrations[num_providers];

// Each record stands in front of the one before it: the head of the list is the last one.
constexpr const Registration* previous(unsigned index) { return index == 0 ? nullptr : &registrations[index - 1]; }

constinit const Registration registrations[num_providers] = {
#define ZMLR_PROVIDER(Class, interfaces, state)                                                                                  \
    {"zmlrprovider_Module", #Class "_Provider", __cimple_##Class##_Provider_proc, &Class::static_meta_class,                     \
     previous(INDEX_##Class)},
#include "providers/providers.def"
#undef ZMLR_PROVIDER
};

constinit CMPI_Static_Data static_data[num_providers] = {};

template <class MI> MI* create_mi(unsigned index, const CMPIBroker* broker, const CMPIContext* context, char kind) noexcept
{
    void* mi = nullptr;
    const Registration& registration = registrations[index];
    cimple_cmpi_adapter('C', &static_data[index], &registration, broker, context, registration.provider_name, kind, &mi);
    return static_cast<MI*>(mi);
}

} // namespace

} // namespace zmlr

#define ZMLR_EXPORT extern "C" [[gnu::visibility("default")]]

ZMLR_EXPORT const zmlr::Registration* cimple_module() { return &zmlr::registrations[zmlr::num_providers - 1]; }

// The two forms of each factory. The short one's status is the server's own: it is left as it came.
#define ZMLR_FACTORY(Class, interface, letter)                                                                                   \
    ZMLR_EXPORT CMPI##interface##MI* Class##_Provider_Create_##interface##MI(const CMPIBroker* broker,                           \
                                                                             const CMPIContext* context) noexcept                \
    {                                                                                                                            \
        return zmlr::create_mi<CMPI##interface##MI>(zmlr::INDEX_##Class, broker, context, letter);                               \
    }                                                                                                                            \
    ZMLR_EXPORT CMPI##interface##MI* Class##_Create_##interface##MI(const CMPIBroker* broker, const CMPIContext* context,        \
                                                                    CMPIStatus*) noexcept                                        \
    {                                                                                                                            \
        return Class##_Provider_Create_##interface##MI(broker, context);                                                         \
    }

#define ZMLR_FACTORIES_INSTANCE(Class)                                                                                           \
    ZMLR_FACTORY(Class, Instance, 'I')                                                                                           \
    ZMLR_FACTORY(Class, Method, 'M')
#define ZMLR_FACTORIES_ASSOCIATION(Class)                                                                                        \
    ZMLR_FACTORIES_INSTANCE(Class)                                                                                               \
    ZMLR_FACTORY(Class, Association, 'A')
#define ZMLR_FACTORIES_INDICATION(Class)                                                                                         \
    ZMLR_FACTORY(Class, Indication, 'N')                                                                                         \
    ZMLR_FACTORY(Class, Method, 'M')

#define ZMLR_PROVIDER(Class, interfaces, state) ZMLR_FACTORIES_##interfaces(Class)
#include "providers/providers.def"
#undef ZMLR_PROVIDER
