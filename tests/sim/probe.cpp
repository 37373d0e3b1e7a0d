// A program that knows nothing of the simulator: opens both nodes and prints what they say about their instances, after a sleep
// of PROBE_SLEEP seconds.
#include <fcntl.h>
#include <sys/ioctl.h>
#include <unistd.h>

#include <array>
#include <cerrno>
#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <cstring>
#include <ctime>

namespace
{

void probe(const char* path, unsigned long code)
{
    int node = open(path, O_RDWR);
    std::array<std::uint32_t, 10> record{};
    if (node < 0)
        std::printf("%s: open: %s\n", path, std::strerror(errno));
    else if (ioctl(node, code, record.data()) != 0)
        std::printf("%s: ioctl: %s\n", path, std::strerror(errno));
    else
        std::printf("%s: %u\n", path, record[0]);
    if (node >= 0)
        close(node);
}

} // namespace

int main()
{
    if (const char* seconds = std::getenv("PROBE_SLEEP"))
    {
        const timespec pause{.tv_sec = std::atoi(seconds), .tv_nsec = 0};
        nanosleep(&pause, nullptr);
    }
    probe("/dev/hxa", 0xC0284302);
    probe("/dev/hxn", 0xC0284402);
}
