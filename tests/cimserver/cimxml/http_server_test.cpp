// The HTTP server against clients that are slow, leave or come in crowds: are others served meanwhile?
#include "cimserver/cimxml/http_server.h"
#include "cimserver/cimxml/worker_pool.h"

#include "raw_client.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <array>
#include <atomic>
#include <future>
#include <set>
#include <thread>
#include <utility>
#include <vector>

using namespace cimserver;
using namespace std::chrono_literals;
using test::post;
using test::Raw_Client;

namespace
{

constexpr std::size_t big_bytes = std::size_t{32} << 20;

// The handler answers the body it got, "quick" at once and others by a worker; "wait" holds that until release(), "big" is
// answered with much.
class http_server : public testing::Test
{
protected:
    Http_Endpoint endpoint;
    Http_Limits limits;
    std::promise<void> released;
    std::shared_future<void> release_signal{released.get_future()};
    bool is_released = false;
    std::atomic<int> holding = 0;
    std::unique_ptr<Http_Server> server;

    void start()
    {
        server = std::make_unique<Http_Server>(endpoint, limits, nullptr,
                                               [this](const Http_Request& request) { return handle(request); });
    }

    Http_Work handle(const Http_Request& request)
    {
        if (request.body == "quick")
            return {{200, "", request.body}, {}};
        return {{}, [&] { return work(request.body); }};
    }

    Http_Answer work(const std::string& body)
    {
        if (body == "wait")
        {
            ++holding;
            release_signal.wait();
        }
        if (body == "big")
        {
            ++holding;
            return {200, "", std::string(big_bytes, 'x')};
        }
        return {200, "", body};
    }

    void release()
    {
        if (!std::exchange(is_released, true))
            released.set_value();
    }

    void TearDown() override { release(); } // the server waits for what it runs

    void wait_until_holding(int requests) const
    {
        for (int i = 0; i < 1000 && holding < requests; ++i)
            std::this_thread::sleep_for(10ms);
        ASSERT_EQ(holding, requests);
    }

    Raw_Client connect() const { return Raw_Client(server->port()); }

    std::string ask(const std::string& bytes) const
    {
        Raw_Client client = connect();
        client.send(bytes);
        return client.receive();
    }

    // "200", or the status alone of any other answer.
    std::string status_of(const std::string& bytes) const { return ask(bytes).substr(9, 3); }

    void expect_served() const { EXPECT_EQ(status_of(post("hello")), "200"); }
};

bool has(const std::string& text, const std::string& part) { return text.find(part) != std::string::npos; }

} // namespace

TEST_F(http_server, serves_others_while_clients_are_slow_and_cuts_those)
{
    limits.receive = 1000ms;
    start();
    Raw_Client silent = connect();
    Raw_Client in_head = connect();
    Raw_Client in_body = connect();
    in_body.send("POST / HTTP/1.1\r\nHost: localhost\r\nContent-Length: 1000\r\n\r\n");
    const std::string head = post("x");
    bool head_open = true;
    bool body_open = true;
    for (std::size_t i = 0; i < 40 && (head_open || body_open); ++i) // a byte every 100 ms
    {
        head_open = head_open && in_head.send(head.substr(i, 1));
        body_open = body_open && in_body.send("x");
        expect_served();
        std::this_thread::sleep_for(100ms);
    }
    EXPECT_FALSE(head_open);
    EXPECT_FALSE(body_open);
    EXPECT_TRUE(silent.closed_within(5s));
}

TEST_F(http_server, lets_new_clients_in_when_silent_ones_hold_every_connection)
{
    limits.connections = 20;
    start();
    std::vector<Raw_Client> silent;
    for (int i = 0; i < 200; ++i)
        silent.push_back(connect());
    for (int i = 0; i < 5; ++i)
        expect_served();
    EXPECT_TRUE(silent.front().closed_within(5s));
}

TEST_F(http_server, cuts_clients_that_do_not_take_their_answers_to_make_room)
{
    limits.connections = 8;
    limits.answer_bytes = 3 * big_bytes;
    start();
    std::vector<Raw_Client> lazy;
    for (int i = 0; i < 12; ++i)
    {
        lazy.push_back(connect());
        lazy.back().send(post("big") + post("big"));
        EXPECT_FALSE(lazy.back().closed_within(10s)) << "its answer has begun";
    }
    for (int i = 0; i < 5; ++i)
        expect_served();
    EXPECT_LT(lazy.front().receive().size(), big_bytes) << "the first one is cut";
}

TEST_F(http_server, replaces_workers_that_hang_and_stops_without_them)
{
    limits.workers = 2;
    start();
    std::vector<Raw_Client> hanging;
    for (int i = 0; i < 3; ++i)
    {
        hanging.push_back(connect());
        hanging.back().send(post("wait"));
    }
    wait_until_holding(2);
    EXPECT_EQ(status_of(post("quick")), "200");
    EXPECT_EQ(status_of(post("hello")), "200") << "once the workers are stuck, others take their place";
    wait_until_holding(3);
    std::this_thread::sleep_for(Worker_Pool::stuck_after);
    const auto begin = std::chrono::steady_clock::now();
    EXPECT_FALSE(server->stop(60s));
    EXPECT_LT(std::chrono::steady_clock::now() - begin, 5s);
    release();
}

TEST_F(http_server, answers_503_when_too_many_requests_wait)
{
    limits.workers = 1;
    limits.waiting_requests = 1;
    start();
    Raw_Client running = connect();
    running.send(post("wait"));
    wait_until_holding(1);
    std::array<std::future<std::string>, 3> crowd; // one of them waits for the worker, whichever comes first
    for (auto& answer : crowd)
        answer = std::async(std::launch::async, [this] { return ask(post("hello")); });
    const auto answered = [](const auto& answer) { return answer.wait_for(0s) == std::future_status::ready; };
    for (int i = 0; i < 1000 && std::ranges::count_if(crowd, answered) < 2; ++i)
        std::this_thread::sleep_for(10ms);
    release();
    std::multiset<std::string> statuses;
    for (auto& answer : crowd)
    {
        const std::string text = answer.get();
        statuses.insert(text.substr(0, 12) + (has(text, "\r\nRetry-After: 1\r\n") ? ", later" : ""));
    }
    EXPECT_EQ(statuses, std::multiset<std::string>({"HTTP/1.1 200", "HTTP/1.1 503, later", "HTTP/1.1 503, later"}));
    EXPECT_TRUE(running.receive().starts_with("HTTP/1.1 200 "));
    expect_served();
}

TEST_F(http_server, survives_clients_that_leave)
{
    limits.workers = 1;
    limits.receive = 1000ms; // the end of a half-closed connection may be noticed only by its deadline
    start();
    {
        Raw_Client in_body = connect();
        in_body.send("POST / HTTP/1.1\r\nHost: localhost\r\nContent-Length: 10\r\n\r\nabc");
        Raw_Client in_work = connect();
        in_work.send(post("wait"));
        wait_until_holding(1);
        Raw_Client before_answer = connect();
        before_answer.send(post("big"));
    }
    release();
    Raw_Client unfinished = connect();
    unfinished.send("POST / HTTP/1.1\r\nHost: localhost\r\nContent-Length: 10\r\n\r\nabc");
    unfinished.end_sending();
    EXPECT_TRUE(unfinished.closed_within(5s));
    expect_served();
}

TEST_F(http_server, cuts_a_client_that_does_not_take_its_answer)
{
    limits.send = 500ms;
    start();
    Raw_Client lazy = connect();
    lazy.send(post("big"));
    wait_until_holding(1);
    const auto begin = std::chrono::steady_clock::now();
    EXPECT_TRUE(server->stop(60s)); // waits for answers to leave
    EXPECT_LT(std::chrono::steady_clock::now() - begin, 30s);
    EXPECT_LT(lazy.receive().size(), big_bytes);
}

TEST_F(http_server, stops_after_the_running_requests)
{
    start();
    Raw_Client idle = connect();
    Raw_Client running = connect();
    running.send(post("wait"));
    wait_until_holding(1);
    EXPECT_FALSE(server->stop(100ms));
    EXPECT_FALSE(connect().connected());
    release();
    EXPECT_TRUE(server->stop(10s));
    EXPECT_TRUE(running.receive().ends_with("wait"));
    EXPECT_TRUE(idle.closed_within(1s));
}
