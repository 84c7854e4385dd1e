// The sibling is fetch_win.cpp.

#include "host/xos_url/curl_library_posix.h"
#include "host/xos_url/fetch.h"
#include "host/xos_url/reason.h"

#include <cerrno>
#include <string_view>

namespace host {

namespace {

/// One transfer.
class Handle {
public:
    explicit Handle(CurlLibrary const& curl) : curl_(curl), handle_(curl.easyInit()) {}
    Handle(Handle const&) = delete;
    Handle& operator=(Handle const&) = delete;
    ~Handle() {
        KeepReason const keep;
        curl_.easyCleanup(handle_);
    }

    bool isMade() const { return handle_ != nullptr; }
    template <class Value>
    bool set(CURLoption option, Value value) const {
        return curl_.easySetopt(handle_, option, value) == CURLE_OK;
    }
    long number(CURLINFO which) const {
        long number = 0;
        curl_.easyGetinfo(handle_, which, &number);
        return number;
    }
    CURLcode perform() const { return curl_.easyPerform(handle_); }

private:
    CurlLibrary const& curl_;
    CURL* handle_;
};

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

bool setCredentials(Handle const& handle, FetchRequest const& request) {
    if (request.user == nullptr) return true;
    return handle.set(CURLOPT_USERNAME, request.user) &&
           handle.set(CURLOPT_PASSWORD, request.password == nullptr ? "" : request.password);
}

bool prepare(Handle const& handle, FetchRequest const& request, Body& body, bool& hasHead) {
    return handle.set(CURLOPT_URL, request.url.c_str()) && handle.set(CURLOPT_NOSIGNAL, 1L) &&
           handle.set(CURLOPT_PROTOCOLS_STR, "http,https") && handle.set(CURLOPT_REDIR_PROTOCOLS_STR, "http,https") &&
           handle.set(CURLOPT_FOLLOWLOCATION, 1L) && handle.set(CURLOPT_MAXREDIRS, long{MOST_REDIRECTS}) &&
           handle.set(CURLOPT_FAILONERROR, 1L) &&
           handle.set(CURLOPT_CONNECTTIMEOUT, static_cast<long>(request.connectSeconds)) &&
           handle.set(CURLOPT_LOW_SPEED_LIMIT, 1L) &&
           handle.set(CURLOPT_LOW_SPEED_TIME, static_cast<long>(request.stallSeconds)) &&
           handle.set(CURLOPT_HTTPAUTH, static_cast<long>(CURLAUTH_ANY)) &&
           handle.set(CURLOPT_WRITEFUNCTION, takeBody) && handle.set(CURLOPT_WRITEDATA, &body) &&
           handle.set(CURLOPT_HEADERFUNCTION, watchHead) && handle.set(CURLOPT_HEADERDATA, &hasHead) &&
           setCredentials(handle, request);
}

long statusOf(Handle const& handle) { return handle.number(CURLINFO_RESPONSE_CODE); }

/// The error with which connecting failed.
int connectError(Handle const& handle) {
    long const error = handle.number(CURLINFO_OS_ERRNO);
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
    CURLcode const code = handle.perform();
    if (code != CURLE_OK) return failForCode(code, handle, body);
    if (!hasHead) return failFor(Reason::BAD_ANSWER);
    return isGoodAnswer(statusOf(handle)) || failForStatus(statusOf(handle));
}

} // namespace

bool fetch(FetchRequest const& request, BodySink& sink) {
    CurlLibrary const* const curl = curlLibrary();
    if (curl == nullptr) {
        errno = ELIBACC;
        return false;
    }
    Handle const handle{*curl};
    Body body{sink};
    if (handle.isMade()) return perform(handle, request, body);
    errno = ENOMEM;
    return false;
}

} // namespace host
