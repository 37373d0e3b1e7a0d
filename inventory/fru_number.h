// The FRU number of a card, out of its vital product data: the resource tags and keywords of PCI 2.2, appendix I.
#pragma once

#include "hxal/records/ioc.h"
#include "runtime/string.h"

namespace zmlr
{

// The card's FRU number as it stands in the data, at most 16 characters (of a card that carries it as plain text: up to the end
// of the text). Empty, with a log line, when the data are damaged or of another layout; empty without one when no keyword
// carries a number. Reads nothing beyond the 512 bytes, whatever their lengths say.
String getFRUNumber(const hxa_mfg_vpd_t& vpd);

} // namespace zmlr
