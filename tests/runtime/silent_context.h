// A thread context with no server behind it: threads have none of their own, and every question fails.
#pragma once

#include "runtime/thread_context.h"

class Silent_Context : public zmlr::Thread_Context
{
public:
    Thread_Context* thread_create_hook(void*) override { return nullptr; }
    void thread_start_hook() noexcept override {}
    void thread_exit_hook() noexcept override {}
    int instance_enumerator_create(const char*, const zmlr::Instance*, zmlr::Instance_Enumerator_Rep*&) override { return -1; }
    void instance_enumerator_destroy(zmlr::Instance_Enumerator_Rep*) override {}
    bool instance_enumerator_more(const zmlr::Instance_Enumerator_Rep*) override { return false; }
    void instance_enumerator_next(zmlr::Instance_Enumerator_Rep*) override {}
    zmlr::Ref<zmlr::Instance> instance_enumerator_get(const zmlr::Instance_Enumerator_Rep*) override { return {}; }
    zmlr::Ref<zmlr::Instance> get_instance(const char*, const zmlr::Instance*) override { return {}; }
    int create_instance(const char*, const zmlr::Instance*) override { return -1; }
    int delete_instance(const char*, const zmlr::Instance*) override { return -1; }
    int modify_instance(const char*, const zmlr::Instance*) override { return -1; }
    int invoke_method(const char*, const zmlr::Instance*, zmlr::Instance*) override { return -1; }
    void allow_unload(bool) override {}
    bool get_username(zmlr::String&) override { return false; }
};
