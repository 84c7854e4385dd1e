// Sibling: fetch_win.cpp.

#include "host/xos_url/fetch.h"

#include <curl/curl.h>
#include <memory>
#include <string_view>

namespace host {

namespace {

using Handle = std::unique_ptr<CURL, decltype(&curl_easy_cleanup)>;

bool isReady() {
    static bool const ready = curl_global_init(CURL_GLOBAL_DEFAULT) == CURLE_OK;
    return ready;
}

/// The bodies of answers that lead on are the library's own business; those of errors it drops.
std::size_t takeBody(char* data, std::size_t unit, std::size_t count, void* sink) {
    std::size_t const size = unit * count;
    return static_cast<BodySink*>(sink)->take(data, size) ? size : 0;
}

/// Notes whether the answer's head came to its end: a connection that is lost before counts as an empty answer here.
std::size_t watchHead(char* line, std::size_t unit, std::size_t count, void* hasHead) {
    std::string_view const text{line, unit * count};
    if (text.substr(0, 5) == "HTTP/") {
        *static_cast<bool*>(hasHead) = false;
    } else if (text == "\r\n" || text == "\n") {
        *static_cast<bool*>(hasHead) = true;
    }
    return text.size();
}

template <class Value>
bool set(Handle const& handle, CURLoption option, Value value) {
    return curl_easy_setopt(handle.get(), option, value) == CURLE_OK;
}

bool setCredentials(Handle const& handle, FetchRequest const& request) {
    if (request.user == nullptr) { return true; }
    return set(handle, CURLOPT_USERNAME, request.user) &&
           set(handle, CURLOPT_PASSWORD, request.password == nullptr ? "" : request.password);
}

bool prepare(Handle const& handle, FetchRequest const& request, BodySink& sink, bool& hasHead) {
    return set(handle, CURLOPT_URL, request.url.c_str()) && set(handle, CURLOPT_NOSIGNAL, 1L) &&
           set(handle, CURLOPT_PROTOCOLS_STR, "http,https") && set(handle, CURLOPT_REDIR_PROTOCOLS_STR, "http,https") &&
           set(handle, CURLOPT_FOLLOWLOCATION, 1L) && set(handle, CURLOPT_MAXREDIRS, long{MOST_REDIRECTS}) &&
           set(handle, CURLOPT_FAILONERROR, 1L) &&
           set(handle, CURLOPT_CONNECTTIMEOUT, static_cast<long>(request.connectSeconds)) &&
           set(handle, CURLOPT_LOW_SPEED_LIMIT, 1L) &&
           set(handle, CURLOPT_LOW_SPEED_TIME, static_cast<long>(request.stallSeconds)) &&
           set(handle, CURLOPT_HTTPAUTH, static_cast<long>(CURLAUTH_ANY)) &&
           set(handle, CURLOPT_WRITEFUNCTION, takeBody) && set(handle, CURLOPT_WRITEDATA, &sink) &&
           set(handle, CURLOPT_HEADERFUNCTION, watchHead) && set(handle, CURLOPT_HEADERDATA, &hasHead) &&
           setCredentials(handle, request);
}

bool isGoodAnswer(Handle const& handle) {
    long status = 0;
    curl_easy_getinfo(handle.get(), CURLINFO_RESPONSE_CODE, &status);
    return status >= 200 && status < 300;
}

} // namespace

bool fetch(FetchRequest const& request, BodySink& sink) {
    if (!isReady()) { return false; }
    Handle const handle{curl_easy_init(), curl_easy_cleanup};
    bool hasHead = false;
    return handle != nullptr && prepare(handle, request, sink, hasHead) &&
           curl_easy_perform(handle.get()) == CURLE_OK && hasHead && isGoodAnswer(handle);
}

} // namespace host
