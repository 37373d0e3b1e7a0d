// Where the library's own calls go. This program has the file operations of its own: the real ones would touch "/etc".
#include "hxal/hxal.h"

#include <gtest/gtest.h>

#include <string>

static std::string calls;

extern "C"
{
    hxa_status_t hxal_config_load(const char* path)
    {
        calls += std::string("load ") + path + ";";
        return HXA_STATUS_BAD_FILE;
    }

    hxa_status_t hxal_config_sync(const char* path)
    {
        calls += std::string("sync ") + path + ";";
        return HXA_STATUS_EFOPEN;
    }

    void hxal_config_unload(void) { calls += "unload;"; }
}

TEST(Libload, works_on_the_drivers_file)
{
    EXPECT_EQ(hxal_libload(), HXA_STATUS_BAD_FILE);
    hxal_libsync();
    hxal_libunload();
    EXPECT_EQ(calls, "load /etc/hxa.conf;sync /etc/hxa.conf;unload;");
}
