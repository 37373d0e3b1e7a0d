#include "cimserver/indications/export_transfer.h"

#include "cimserver/indications/export_message.h"

#include <sys/socket.h>

#include <new>

namespace cimserver
{
namespace
{

constexpr std::size_t max_answer_bytes = 64 * 1024;

// The module may start programs: they must not inherit connections.
curl_socket_t open_socket(void*, curlsocktype, curl_sockaddr* address)
{
    return socket(address->family, address->socktype | SOCK_CLOEXEC, address->protocol);
}

} // namespace

Export_Transfer::Export_Transfer(const std::string& url, std::shared_ptr<const std::string> message,
                                 std::chrono::milliseconds timeout, const std::string& ca_file)
    : _message(std::move(message))
    , _handle(curl_easy_init(), curl_easy_cleanup)
{
    if (!_handle)
        throw std::bad_alloc();
    curl_easy_setopt(handle(), CURLOPT_URL, url.c_str());
    curl_easy_setopt(handle(), CURLOPT_POSTFIELDSIZE_LARGE, static_cast<curl_off_t>(_message->size()));
    curl_easy_setopt(handle(), CURLOPT_POSTFIELDS, _message->c_str());
    curl_easy_setopt(handle(), CURLOPT_WRITEFUNCTION, take_answer);
    curl_easy_setopt(handle(), CURLOPT_WRITEDATA, this);
    set_headers();
    set_limits(timeout, ca_file);
}

void Export_Transfer::set_headers()
{
    for (const char* header : {"Content-Type: application/xml; charset=\"utf-8\"", "CIMExport: MethodRequest",
                               "CIMExportMethod: ExportIndication", "Expect:"})
    {
        curl_slist* longer = curl_slist_append(_headers.get(), header);
        if (!longer)
            throw std::bad_alloc();
        (void)_headers.release();
        _headers.reset(longer);
    }
    curl_easy_setopt(handle(), CURLOPT_HTTPHEADER, _headers.get());
}

// What the client named is what is asked: no other protocol, no redirection, no proxy of the environment.
void Export_Transfer::set_limits(std::chrono::milliseconds timeout, const std::string& ca_file)
{
    curl_easy_setopt(handle(), CURLOPT_PROTOCOLS_STR, "http,https");
    curl_easy_setopt(handle(), CURLOPT_PROXY, "");
    curl_easy_setopt(handle(), CURLOPT_TIMEOUT_MS, static_cast<long>(timeout.count()));
    curl_easy_setopt(handle(), CURLOPT_NOSIGNAL, 1L);
    curl_easy_setopt(handle(), CURLOPT_QUICK_EXIT, 1L); // a name server that hangs does not hold up the end
    curl_easy_setopt(handle(), CURLOPT_OPENSOCKETFUNCTION, open_socket);
    if (!ca_file.empty())
        curl_easy_setopt(handle(), CURLOPT_CAINFO, ca_file.c_str());
}

// More than fits ends the transfer: no listener has that much to say.
std::size_t Export_Transfer::take_answer(char* data, std::size_t size, std::size_t count, void* self) noexcept
try
{
    std::string& answer = static_cast<Export_Transfer*>(self)->_answer;
    if (answer.size() + size * count > max_answer_bytes)
        return 0;
    answer.append(data, size * count);
    return size * count;
}
catch (...)
{
    return 0;
}

long Export_Transfer::status() const
{
    long status = 0;
    curl_easy_getinfo(handle(), CURLINFO_RESPONSE_CODE, &status);
    return status;
}

Export_Outcome Export_Transfer::outcome(CURLcode result) const
{
    const long code = status();
    if (result != CURLE_OK || code == 408 || code == 429 || code >= 500)
        return Export_Outcome::not_taken;
    return code / 100 == 2 && !tells_error(_answer) ? Export_Outcome::taken : Export_Outcome::refused;
}

std::string Export_Transfer::problem(CURLcode result) const
{
    if (result != CURLE_OK)
        return curl_easy_strerror(result);
    return status() / 100 == 2 ? "it answers an error" : "it answers HTTP status " + std::to_string(status());
}

} // namespace cimserver
