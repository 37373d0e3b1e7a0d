#include "indications/event_index.h"

#include "runtime/log.h"
#include "runtime/trace.h"

namespace zmlr
{

namespace
{

constexpr const char* log_source = "IndicationHelper";

struct Event_Index
{
    Event_Index();

    int min[HXA_AEN_MAX_CAT + 1] = {};
    int max[HXA_AEN_MAX_CAT + 1] = {};
};

uint32 category_of(int32_t id) { return static_cast<uint32>(id) >> 16 & 0xFF; }

Event_Index::Event_Index()
{
    uint32 before = 0;
    for (int row = 0; hxal_aen_msg_array[row].id != 0; row++)
    {
        const uint32 category = category_of(hxal_aen_msg_array[row].id);
        if (category > HXA_AEN_MAX_CAT)
            continue;
        if (category != before)
            min[category] = row;
        max[category] = row;
        before = category;
    }
}

const Event_Index& event_index()
{
    static const Event_Index index;
    return index;
}

} // namespace

bool initEventIndex()
{
    const Scope_Trace trace(log_source);
    event_index();
    return true;
}

void getIndexBoundaryForCategory(hxa_aen_category_t category, int* min, int* max)
{
    const Scope_Trace trace(log_source);
    *min = event_index().min[category];
    *max = event_index().max[category];
    ZMLR_LOG(LL_DBG, "The boundary : Category = %d, MinIndex = %d, MaxIndex = %d ", static_cast<int>(category), *min, *max);
}

bool getEventIndexInArray(hxa_aen_category_t category, uint32 id, int* index)
{
    const Scope_Trace trace(log_source);
    int row = 0;
    int last = 0;
    getIndexBoundaryForCategory(category, &row, &last);
    for (; row <= last; row++)
    {
        if (static_cast<uint32>(hxal_aen_msg_array[row].id) == id)
        {
            *index = row;
            return true;
        }
    }
    return false;
}

} // namespace zmlr
