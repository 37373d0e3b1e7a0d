/* The interface headers serve providers written in C. */
#include <cmpidt.h>
#include <cmpift.h>
#include <cmpimacs.h>

CMPIStatus return_name(const CMPIBroker* broker, const CMPIResult* result);

CMPIStatus return_name(const CMPIBroker* broker, const CMPIResult* result)
{
    CMPIStatus status = {CMPI_RC_OK, NULL};
    CMPIObjectPath* path = CMNewObjectPath(broker, "root/zemlar", "Test_Thing", &status);
    if (path)
    {
        CMAddKey(path, "Name", "a", CMPI_chars);
        CMReturnObjectPath(result, path);
        CMRelease(path);
    }
    return status;
}
