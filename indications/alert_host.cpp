#include "indications/alert_host.h"

#include "inventory/property_text.h"

#include <algorithm>

namespace zmlr
{

String Alert_Host::text()
{
    const Clock::time_point begin = Clock::now();
    if (begin < _good_until)
        return property_text(_host.text());
    _host = Host_Text();
    String text = property_text(_host.text());
    const Clock::time_point end = Clock::now();
    _good_until = end + std::min<Clock::duration>(holds * (end - begin), longest_hold);
    return text;
}

} // namespace zmlr
