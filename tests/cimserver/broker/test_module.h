/* What the test module tells the tests, and what they can make it do. */
#pragma once

#ifdef __cplusplus
extern "C"
{
#endif

    /* `disks` is how many instances TST_Disk has (3 at first); `live_interfaces` is how many interfaces were made and not
     * yet cleaned up. Every one of them is cleaned up with the answer `cleanup_rc`. */
    struct Test_Module_State
    {
        int disks;
        int live_interfaces;
        int cleanup_rc;
    };

    struct Test_Module_State* test_module_state(void);

#ifdef __cplusplus
}
#endif
