// The bound on the memory of all queues, with listeners that take a connection and never answer.
#include "cimserver/indications/delivery.h"

#include <gtest/gtest.h>

#include <netinet/in.h>
#include <sys/socket.h>
#include <unistd.h>

using namespace cimserver;

namespace
{

class Silent_Listener
{
public:
    Silent_Listener() : _socket(socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC, 0))
    {
        sockaddr_in address{};
        address.sin_family = AF_INET;
        address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
        socklen_t size = sizeof address;
        auto* its_address = reinterpret_cast<sockaddr*>(&address);
        EXPECT_EQ(bind(_socket, its_address, size), 0);
        EXPECT_EQ(listen(_socket, 1), 0);
        EXPECT_EQ(getsockname(_socket, its_address, &size), 0);
        _url = "http://127.0.0.1:" + std::to_string(ntohs(address.sin_port));
    }
    ~Silent_Listener()
    {
        close(_connection);
        close(_socket);
    }
    Silent_Listener(const Silent_Listener&) = delete;
    Silent_Listener& operator=(const Silent_Listener&) = delete;

    const std::string& url() const { return _url; }
    void wait_for_message() { _connection = accept(_socket, nullptr, nullptr); }

    std::string tells(const std::string& text) const { return "zmlr-cimserver: listener " + _url + ": " + text + "\n"; }

private:
    int _socket;
    int _connection = -1;
    std::string _url;
};

} // namespace

TEST(delivery, drops_the_oldest_message_of_all_when_all_queues_hold_too_much)
{
    Delivery_Limits limits;
    limits.bytes = 300;
    Delivery delivery(limits);
    Silent_Listener a, b, gone;
    testing::internal::CaptureStderr();
    delivery.keep({a.url(), b.url(), gone.url()});
    const std::string text(100, 'x');
    delivery.send({a.url(), b.url(), gone.url()}, text); // under way to all, hence not to be dropped
    for (Silent_Listener* listener : {&a, &b, &gone})
        listener->wait_for_message();
    delivery.send({b.url()}, text);
    delivery.send({a.url(), b.url()}, text); // 300 bytes wait, each text counted once
    delivery.send({a.url()}, text);
    EXPECT_EQ(testing::internal::GetCapturedStderr(), b.tells("too much waits, indications are lost"));

    testing::internal::CaptureStderr();
    delivery.send({a.url()}, std::string(200, 'x')); // both that wait give way
    delivery.keep({a.url(), b.url()});
    delivery.stop(std::chrono::milliseconds(0));
    const std::string told = testing::internal::GetCapturedStderr();
    for (const std::string& line :
         {a.tells("too much waits, indications are lost"), a.tells("too much waited, 2 indications are lost"),
          a.tells("the server stops, 2 indications are lost"), b.tells("too much waited, 2 indications are lost"),
          b.tells("the server stops, 1 indication is lost"),
          gone.tells("nobody subscribes for it any more, 1 indication is lost")})
        EXPECT_NE(told.find(line), std::string::npos) << line << "is not among\n" << told;
}
