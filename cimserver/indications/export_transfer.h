// One attempt to hand a message to a listener: an HTTP POST of libcurl.
#pragma once

#include <curl/curl.h>

#include <chrono>
#include <memory>
#include <string>

namespace cimserver
{

enum class Export_Outcome
{
    taken,
    refused,  // the listener will not take it, however often it is asked
    not_taken // it may later
};

class Export_Transfer
{
public:
    // Throws std::bad_alloc.
    Export_Transfer(const std::string& url, std::shared_ptr<const std::string> message, std::chrono::milliseconds timeout,
                    const std::string& ca_file);
    Export_Transfer(const Export_Transfer&) = delete;
    Export_Transfer& operator=(const Export_Transfer&) = delete;

    CURL* handle() const { return _handle.get(); }

    // How it ended, once libcurl has ended it with `result`.
    Export_Outcome outcome(CURLcode result) const;
    std::string problem(CURLcode result) const; // why it was not taken, for people

private:
    void set_headers();
    void set_limits(std::chrono::milliseconds timeout, const std::string& ca_file);
    static std::size_t take_answer(char* data, std::size_t size, std::size_t count, void* self) noexcept;
    long status() const;

    std::shared_ptr<const std::string> _message;
    std::string _answer;
    std::unique_ptr<curl_slist, void (*)(curl_slist*)> _headers{nullptr, curl_slist_free_all};
    std::unique_ptr<CURL, void (*)(CURL*)> _handle;
};

} // namespace cimserver
