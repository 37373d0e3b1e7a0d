#include "hxal/internal/list.h"

void hxal::list_free(hxal_s*& head)
{
    while (head)
        delete static_cast<Ioc_Node*>(std::exchange(head, head->next));
}

void hxal::list_free(hxal_adapter_t*& head)
{
    while (head)
    {
        list_free(head->fcioc_list);
        list_free(head->ethioc_list);
        delete std::exchange(head, head->next);
    }
}
