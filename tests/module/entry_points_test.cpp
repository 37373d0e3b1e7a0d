// What a CIM server finds in the module before the first request.

#include "cmpi/registration.h"
#include "tests/module/loaded_module.h"

#include <cmpift.h>
#include <dlfcn.h>
#include <gmock/gmock.h>

#include <string_view>

using testing::StartsWith;

namespace
{

struct Row
{
    const char* class_name;
    std::string_view interfaces;
};

#define ZMLR_PROVIDER(class_name, interfaces, provider) {#class_name, #interfaces},
const Row rows[] = {
#include "providers/providers.def"
};
#undef ZMLR_PROVIDER

class Entry_Points : public Loaded_Module
{
protected:
    void SetUp() override
    {
        load("fc-hba");
        _library = dlopen(module_path, RTLD_NOW | RTLD_NOLOAD);
        ASSERT_NE(_library, nullptr);
    }

    void TearDown() override { dlclose(_library); }

    template <class Function> Function symbol(const std::string& name)
    {
        return reinterpret_cast<Function>(dlsym(_library, name.c_str()));
    }

    // Makes an interface through one form of its factory, compares its tables' head, and cleans it up.
    template <class MI> void try_factory(const std::string& class_name, const char* kind, const std::string& prefix)
    {
        for (const std::string& form : {class_name + "_Provider_Create_" + kind + "MI", class_name + "_Create_" + kind + "MI"})
        {
            SCOPED_TRACE(form);
            auto factory = symbol<MI* (*)(const CMPIBroker*, const CMPIContext*, CMPIStatus*)>(form);
            ASSERT_NE(factory, nullptr);
            CMPIContext context = {};
            CMPIStatus status = {CMPI_RC_ERR_NOT_FOUND, nullptr};
            MI* mi = factory(module().broker().face(), &context, &status);
            ASSERT_NE(mi, nullptr);
            EXPECT_EQ(status.rc, CMPI_RC_ERR_NOT_FOUND) << "the status is not the module's to set";
            EXPECT_EQ(mi->ft->ftVersion, 100);
            EXPECT_EQ(mi->ft->miVersion, 100);
            EXPECT_EQ(mi->ft->miName, prefix + class_name + "_Provider");
            EXPECT_EQ(mi->ft->cleanup(mi, &context, 0).rc, CMPI_RC_OK);
        }
    }

private:
    void* _library = nullptr;
};

} // namespace

TEST_F(Entry_Points, registration_list_holds_the_classes_in_reverse_order)
{
    const auto module_list = symbol<decltype(&cimple_module)>("cimple_module");
    ASSERT_NE(module_list, nullptr);
    const zmlr::Registration* registration = module_list();
    ASSERT_EQ(std::size(rows), 75U);
    for (auto row = std::rbegin(rows); row != std::rend(rows); ++row, registration = registration->next)
    {
        ASSERT_NE(registration, nullptr);
        EXPECT_STREQ(registration->module_name, "zmlrprovider_Module");
        EXPECT_EQ(registration->provider_name, std::string(row->class_name) + "_Provider");
        EXPECT_STREQ(registration->meta_class->name, row->class_name);
    }
    EXPECT_EQ(registration, nullptr);
}

TEST_F(Entry_Points, every_factory_makes_its_interface)
{
    for (const auto& row : rows)
    {
        try_factory<CMPIMethodMI>(row.class_name, "Method", "method");
        if (row.interfaces != "INDICATION")
            try_factory<CMPIInstanceMI>(row.class_name, "Instance", "instance");
        if (row.interfaces == "ASSOCIATION")
            try_factory<CMPIAssociationMI>(row.class_name, "Association", "association");
        if (row.interfaces == "INDICATION")
            try_factory<CMPIIndicationMI>(row.class_name, "Indication", "indication");
    }
}
