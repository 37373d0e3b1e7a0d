// Any settings that a file can make: what is written of them is written again when it was read.
#include "hxal/config/parser.h"
#include "tests/hxal/config_model.h"

#include <cstdint>
#include <fuzzer/FuzzedDataProvider.h>
#include <iterator>
#include <string_view>
#include <sys/mman.h>
#include <unistd.h>

namespace
{

// A model of arbitrary settings, made as a file could make it.
class Arbitrary_Model
{
public:
    Arbitrary_Model(const uint8_t* data, size_t size) : bytes(data, size) {}

    void fill()
    {
        for (int adapters = below(5), i = 0; i <= adapters; ++i)
        {
            parse("adapter-" + text(12) + "-name = " + text(127));
            parse("adapter-" + text(11) + "-power = " + std::to_string(below(4)));
        }
        for (int iocs = below(8), i = 0; i <= iocs; ++i)
            parse("hxa" + std::to_string(below(128)) + "-port-wwn = " + wwn());
        for (int lines = below(400), i = 0; i < lines; ++i)
            parse(below(12) ? "hxa" + std::to_string(below(128)) + "-" + setting() : setting());
        for (int lines = below(20), i = 0; i < lines; ++i)
            parse("hxn" + std::to_string(below(128)) + (below(2) ? "-port-name = " + text(127) : "-port-mac = " + text(31)));
        for (int lines = below(20), i = 0; i < lines; ++i)
            parse("hxa" + std::to_string(below(8)) + "-vport-" + std::to_string(below(300)) + " = " + wwn() + "," + wwn() + "," +
                  (below(3) ? text(127) : "") + "," + text(15) + "," + std::to_string(below(65536)));
        if (below(2))
            parse("power = " + std::to_string(below(4)));
    }

private:
    static void parse(const std::string& line) { hxal_config_parse(line.c_str()); }

    int below(int end) { return bytes.ConsumeIntegralInRange(0, end - 1); }

    template <typename Items> const auto& one_of(const Items& items)
    {
        return items[static_cast<std::size_t>(below(static_cast<int>(std::size(items))))];
    }

    std::string text(int longest)
    {
        constexpr std::string_view letters = "bcefgijkmoqsuvwyzBCE0123456789_.:"; // no word that tells the kind of a line
        std::string made(static_cast<std::size_t>(1 + below(longest)), ' ');
        for (char& letter : made)
            letter = one_of(letters);
        return made;
    }

    std::string wwn() { return "10:00:00:05:1e:10:" + std::to_string(below(10)) + ":" + std::to_string(below(10)); }

    std::string setting()
    {
        struct Keys
        {
            std::vector<const char*> keys;
            std::vector<const char*> words; // none: a number
        };
        // clang-format off
        static const Keys kinds[] = {
            {{"port-speed", "port-maxfrsize", "vf-default", "pathtov", "qdepth", "delay", "latency", "auth-group",
              "ratelim-defspeed"}, {}},
            {{"port-trunk", "vf-list"}, {"", "0", "1, 15", "7,3"}},
            {{"port-hardalpa"}, {"0x1f", "EF"}},
            {{"port-enable", "ipfc-enable", "vf-enable", "qos", "ratelim", "persistent-binding"}, {"TRUE", "FALSE", "true"}},
            {{"auth-policy", "coalesce"}, {"on", "off"}},
            {{"port-topology"}, {"none", "p2p", "loop", "auto", "ring"}},
            {{"log-level"}, {"Critical", "Error", "Warning", "Info", "None"}},
            {{"auth-algo"}, {"md5", "sha1", "ms", "sm"}},
            {{"auth-secretsource"}, {"LOCAL", "RADIUS", "TACACS"}},
            {{"auth-encrypt"}, {"7", "1,22,333"}},
        };
        // clang-format on
        const Keys& kind = one_of(kinds);
        const std::string key = one_of(kind.keys);
        return key + " = " + (kind.words.empty() ? std::to_string(below(70000)) : one_of(kind.words));
    }

    FuzzedDataProvider bytes;
};

void load(const std::string& text)
{
    static const int file = ::memfd_create("hxa.conf", 0);
    static const std::string path = "/proc/self/fd/" + std::to_string(file);
    if (::ftruncate(file, 0) != 0 || ::pwrite(file, text.data(), text.size(), 0) != static_cast<ssize_t>(text.size()))
        __builtin_trap();
    hxal_config_load(path.c_str());
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const uint8_t* data, size_t size)
{
    empty_model();
    Arbitrary_Model(data, size).fill();
    const std::string first = written();
    empty_model();
    load(first);
    if (written() != first)
        __builtin_trap();
    return 0;
}
