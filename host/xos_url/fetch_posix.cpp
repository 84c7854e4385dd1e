// The sibling is fetch_win.cpp.

#include "host/xos_url/fetch.h"
#include "host/xos_url/reason.h"

#include <cerrno>
#include <curl/curl.h>
#include <memory>
#include <string_view>

namespace host {

namespace {

struct Cleanup {
    void operator()(CURL* handle) const {
        KeepReason const keep;
        curl_easy_cleanup(handle);
    }
};

using Handle = std::unique_ptr<CURL, Cleanup>;

bool isReady() {
    static bool const ready = curl_global_init(CURL_GLOBAL_DEFAULT) == CURLE_OK;
    return ready;
}

struct Body {
    BodySink& sink;
    /// Why the sink took no more.
    int error = EIO;
};

/// The bodies of answers that lead on are the library's own business; those of errors it drops.
std::size_t takeBody(char* data, std::size_t unit, std::size_t count, void* context) {
    auto& body = *static_cast<Body*>(context);
    std::size_t const size = unit * count;
    if (body.sink.take(data, size)) return size;
    body.error = errno;
    return 0;
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
    if (request.user == nullptr) return true;
    return set(handle, CURLOPT_USERNAME, request.user) &&
           set(handle, CURLOPT_PASSWORD, request.password == nullptr ? "" : request.password);
}

bool prepare(Handle const& handle, FetchRequest const& request, Body& body, bool& hasHead) {
    return set(handle, CURLOPT_URL, request.url.c_str()) && set(handle, CURLOPT_NOSIGNAL, 1L) &&
           set(handle, CURLOPT_PROTOCOLS_STR, "http,https") && set(handle, CURLOPT_REDIR_PROTOCOLS_STR, "http,https") &&
           set(handle, CURLOPT_FOLLOWLOCATION, 1L) && set(handle, CURLOPT_MAXREDIRS, long{MOST_REDIRECTS}) &&
           set(handle, CURLOPT_FAILONERROR, 1L) &&
           set(handle, CURLOPT_CONNECTTIMEOUT, static_cast<long>(request.connectSeconds)) &&
           set(handle, CURLOPT_LOW_SPEED_LIMIT, 1L) &&
           set(handle, CURLOPT_LOW_SPEED_TIME, static_cast<long>(request.stallSeconds)) &&
           set(handle, CURLOPT_HTTPAUTH, static_cast<long>(CURLAUTH_ANY)) &&
           set(handle, CURLOPT_WRITEFUNCTION, takeBody) && set(handle, CURLOPT_WRITEDATA, &body) &&
           set(handle, CURLOPT_HEADERFUNCTION, watchHead) && set(handle, CURLOPT_HEADERDATA, &hasHead) &&
           setCredentials(handle, request);
}

long statusOf(Handle const& handle) {
    long status = 0;
    curl_easy_getinfo(handle.get(), CURLINFO_RESPONSE_CODE, &status);
    return status;
}

/// The error with which connecting failed.
int connectError(Handle const& handle) {
    long error = 0;
    curl_easy_getinfo(handle.get(), CURLINFO_OS_ERRNO, &error);
    return error != 0 ? static_cast<int>(error) : ECONNREFUSED;
}

int errorOf(CURLcode code, Handle const& handle, Body const& body) {
    switch (code) {
    case CURLE_WRITE_ERROR:
        return body.error;
    case CURLE_COULDNT_RESOLVE_HOST:
    case CURLE_COULDNT_RESOLVE_PROXY:
        return EHOSTUNREACH;
    case CURLE_COULDNT_CONNECT:
        return connectError(handle);
    case CURLE_OPERATION_TIMEDOUT:
        return ETIMEDOUT;
    case CURLE_URL_MALFORMAT:
        return EINVAL;
    case CURLE_UNSUPPORTED_PROTOCOL:
        return EPROTONOSUPPORT;
    case CURLE_TOO_MANY_REDIRECTS:
        return ELOOP;
    case CURLE_OUT_OF_MEMORY:
        return ENOMEM;
    case CURLE_SEND_ERROR:
    case CURLE_RECV_ERROR:
    case CURLE_PARTIAL_FILE:
        return ECONNRESET;
    default:
        return EPROTO;
    }
}

bool failForCode(CURLcode code, Handle const& handle, Body const& body) {
    if (code == CURLE_HTTP_RETURNED_ERROR) return failForStatus(statusOf(handle));
    errno = errorOf(code, handle, body);
    return false;
}

bool isGoodAnswer(long status) { return status >= 200 && status < 300; }

bool perform(Handle const& handle, FetchRequest const& request, Body& body) {
    bool hasHead = false;
    if (!prepare(handle, request, body, hasHead)) return failFor(Reason::BAD_ARGUMENT);
    CURLcode const code = curl_easy_perform(handle.get());
    if (code != CURLE_OK) return failForCode(code, handle, body);
    if (!hasHead) return failFor(Reason::BAD_ANSWER);
    return isGoodAnswer(statusOf(handle)) || failForStatus(statusOf(handle));
}

} // namespace

bool fetch(FetchRequest const& request, BodySink& sink) {
    Handle const handle{isReady() ? curl_easy_init() : nullptr};
    Body body{sink};
    if (handle != nullptr) return perform(handle, request, body);
    errno = ENOMEM;
    return false;
}

} // namespace host
