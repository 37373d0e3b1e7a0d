// Samples of metrics as text, and the file that a collector finds them in.
//
// Two forms that differ in the lines about counters and infos only. OpenMetrics 1.0 names a family without the suffix of its
// samples ("hxa_port_receive_bytes" has the sample "hxa_port_receive_bytes_total"); the Prometheus text format 0.0.4, which the
// textfile collector of the Prometheus node exporter reads, names it as its samples, and takes a counter that is named otherwise
// for an untyped number. Lines that the older format does not have are remarks to it.
#pragma once

#include <cstdint>
#include <span>
#include <string>
#include <string_view>
#include <vector>

namespace hxa::openmetrics
{

struct Sample
{
    std::string_view family; // name of a row of the table; others are not written
    std::uint64_t value;
    std::vector<std::string> labels = {}; // values in the order of the family's names
};

enum class Form
{
    openmetrics,
    collector
};

// The collector reads files whose names end in ".prom", and only them.
Form form_for(std::string_view path);

// The samples by families in the order of the table. Label values may be any bytes: what no XML document could carry becomes
// "?", as in the properties of the CIM classes. Of samples with equal names and labels the first stays, because a collector
// refuses a text with both. An empty label stands for none.
std::string text_of(std::span<const Sample> samples, Form form);

// Replaces a regular file by one with this text and mode 0644, or makes it: a reader sees the old text or the new one, and
// the old one stays when anything fails. Refuses links, devices and all else. Throws std::runtime_error.
void write_file(const std::string& path, std::string_view text);

} // namespace hxa::openmetrics
