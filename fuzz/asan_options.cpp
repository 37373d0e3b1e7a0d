// What every fuzz program asks of the address sanitizer. Freed memory is normally kept back by the hundred megabytes, to catch
// late uses of it; in a long run of many small allocations that alone would pass the limit that makes real growth a finding.
extern "C" const char* __asan_default_options();

const char* __asan_default_options() { return "quarantine_size_mb=8"; }
