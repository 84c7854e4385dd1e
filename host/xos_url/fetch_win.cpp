// The sibling is fetch_posix.cpp.

#include "host/windows_api.h"
#include "host/xos_url/fetch.h"
#include "host/xos_url/reason.h"

#include <cwchar>
#include <memory>
#include <optional>
#include <shlwapi.h>
#include <string>
#include <vector>
#include <winhttp.h>

namespace host {

namespace {

struct CloseInternet {
    using pointer = HINTERNET;
    void operator()(HINTERNET handle) const {
        KeepReason const keep;
        WinHttpCloseHandle(handle);
    }
};
using Handle = std::unique_ptr<HINTERNET, CloseInternet>;

std::wstring wide(std::string const& text, UINT codePage) {
    int const length = static_cast<int>(text.size());
    std::wstring result(static_cast<std::size_t>(MultiByteToWideChar(codePage, 0, text.data(), length, nullptr, 0)),
                        L'\0');
    MultiByteToWideChar(codePage, 0, text.data(), length, result.data(), static_cast<int>(result.size()));
    return result;
}

struct Address {
    std::wstring host;
    INTERNET_PORT port;
    std::wstring object;
    bool isSecure;
    std::optional<std::wstring> user;
    std::wstring password;
};

std::wstring decoded(std::wstring const& text) {
    std::wstring result;
    for (std::size_t i = 0; i < text.size(); ++i) {
        bool const isEscape = text[i] == L'%' && i + 2 < text.size();
        result += isEscape ? static_cast<wchar_t>(std::wcstoul(text.substr(i + 1, 2).c_str(), nullptr, 16)) : text[i];
        i += isEscape ? 2 : 0;
    }
    return result;
}

void takeCredentials(FetchRequest const& request, URL_COMPONENTS const& parts, Address& address) {
    if (request.user != nullptr) {
        address.user = wide(request.user, CP_ACP);
        address.password = request.password == nullptr ? std::wstring{} : wide(request.password, CP_ACP);
    } else if (parts.dwUserNameLength != 0) {
        address.user = decoded({parts.lpszUserName, parts.dwUserNameLength});
        address.password = decoded({parts.lpszPassword, parts.dwPasswordLength});
    }
}

std::optional<Address> addressOf(std::wstring url, FetchRequest const& request) {
    url.resize(url.find(L'#') == std::wstring::npos ? url.size() : url.find(L'#'));
    URL_COMPONENTS parts{};
    parts.dwStructSize = sizeof parts;
    // Asks for pointers into the URL.
    parts.dwHostNameLength = parts.dwUrlPathLength = parts.dwExtraInfoLength = DWORD(-1);
    parts.dwUserNameLength = parts.dwPasswordLength = DWORD(-1);
    if (WinHttpCrackUrl(url.c_str(), static_cast<DWORD>(url.size()), 0, &parts) == FALSE) return std::nullopt;
    Address address{{parts.lpszHostName, parts.dwHostNameLength},
                    parts.nPort,
                    std::wstring(parts.lpszUrlPath, parts.dwUrlPathLength) +
                        std::wstring(parts.lpszExtraInfo, parts.dwExtraInfoLength),
                    parts.nScheme == INTERNET_SCHEME_HTTPS,
                    std::nullopt,
                    {}};
    takeCredentials(request, parts, address);
    return address;
}

Handle openSession(FetchRequest const& request) {
    Handle session{
        WinHttpOpen(L"xos_url", WINHTTP_ACCESS_TYPE_DEFAULT_PROXY, WINHTTP_NO_PROXY_NAME, WINHTTP_NO_PROXY_BYPASS, 0)};
    if (session != nullptr) {
        int const connect = static_cast<int>(request.connectSeconds * 1000);
        int const stall = static_cast<int>(request.stallSeconds * 1000);
        WinHttpSetTimeouts(session.get(), connect, connect, stall, stall);
    }
    return session;
}

bool setNumber(HINTERNET handle, DWORD option, DWORD value) {
    return WinHttpSetOption(handle, option, &value, sizeof value) != FALSE;
}

Handle openRequest(HINTERNET connection, Address const& address) {
    Handle request{WinHttpOpenRequest(connection, L"GET", address.object.c_str(), nullptr, WINHTTP_NO_REFERER,
                                      WINHTTP_DEFAULT_ACCEPT_TYPES, address.isSecure ? WINHTTP_FLAG_SECURE : 0)};
    if (request != nullptr) {
        setNumber(request.get(), WINHTTP_OPTION_REDIRECT_POLICY, WINHTTP_OPTION_REDIRECT_POLICY_NEVER);
    }
    return request;
}

/// \return the status; 0 when no answer came
DWORD exchange(HINTERNET request) {
    DWORD status = 0;
    DWORD size = sizeof status;
    bool const answered =
        WinHttpSendRequest(request, WINHTTP_NO_ADDITIONAL_HEADERS, 0, WINHTTP_NO_REQUEST_DATA, 0, 0, 0) != FALSE &&
        WinHttpReceiveResponse(request, nullptr) != FALSE &&
        WinHttpQueryHeaders(request, WINHTTP_QUERY_STATUS_CODE | WINHTTP_QUERY_FLAG_NUMBER,
                            WINHTTP_HEADER_NAME_BY_INDEX, &status, &size, WINHTTP_NO_HEADER_INDEX) != FALSE;
    return answered ? status : 0;
}

/// The strongest that the server offers and the system masters.
DWORD bestScheme(DWORD offered) {
    for (DWORD const scheme : {DWORD{WINHTTP_AUTH_SCHEME_NEGOTIATE}, DWORD{WINHTTP_AUTH_SCHEME_NTLM},
                               DWORD{WINHTTP_AUTH_SCHEME_DIGEST}, DWORD{WINHTTP_AUTH_SCHEME_BASIC}}) {
        if ((offered & scheme) != 0) return scheme;
    }
    return 0;
}

bool giveCredentials(HINTERNET request, Address const& address) {
    DWORD offered = 0;
    DWORD first = 0;
    DWORD target = 0;
    return address.user.has_value() && WinHttpQueryAuthSchemes(request, &offered, &first, &target) != FALSE &&
           WinHttpSetCredentials(request, target, bestScheme(offered), address.user->c_str(), address.password.c_str(),
                                 nullptr) != FALSE;
}

DWORD exchangeWithCredentials(HINTERNET request, Address const& address) {
    DWORD const status = exchange(request);
    bool const isAsked = status == HTTP_STATUS_DENIED;
    return isAsked && giveCredentials(request, address) ? exchange(request) : status;
}

std::wstring header(HINTERNET request, DWORD which) {
    DWORD size = 0;
    WinHttpQueryHeaders(request, which, WINHTTP_HEADER_NAME_BY_INDEX, nullptr, &size, WINHTTP_NO_HEADER_INDEX);
    std::wstring text(size / sizeof(wchar_t) + 1, L'\0');
    size = static_cast<DWORD>(text.size() * sizeof(wchar_t));
    if (WinHttpQueryHeaders(request, which, WINHTTP_HEADER_NAME_BY_INDEX, text.data(), &size,
                            WINHTTP_NO_HEADER_INDEX) == FALSE) {
        return {};
    }
    text.resize(size / sizeof(wchar_t));
    return text;
}

std::optional<std::uint64_t> announcedLength(HINTERNET request) {
    std::wstring const digits = header(request, WINHTTP_QUERY_CONTENT_LENGTH);
    return digits.empty() ? std::nullopt : std::optional<std::uint64_t>{std::wcstoull(digits.c_str(), nullptr, 10)};
}

/// A connection that ends early reads like the end of the body, so the length is compared.
bool readBody(HINTERNET request, BodySink& sink) {
    std::optional<std::uint64_t> const announced = announcedLength(request);
    std::vector<char> piece(65536);
    std::uint64_t received = 0;
    for (;;) {
        DWORD count = 0;
        if (WinHttpReadData(request, piece.data(), static_cast<DWORD>(piece.size()), &count) == FALSE) return false;
        if (count == 0) return !announced.has_value() || *announced == received || failFor(Reason::BAD_ANSWER);
        received += count;
        if (!sink.take(piece.data(), count)) return false;
    }
}

bool leadsOn(DWORD status) {
    constexpr DWORD PERMANENT_REDIRECT = 308; // as 301, and newer than some of the libraries
    return status == HTTP_STATUS_MOVED || status == HTTP_STATUS_REDIRECT || status == HTTP_STATUS_REDIRECT_METHOD ||
           status == HTTP_STATUS_REDIRECT_KEEP_VERB || status == PERMANENT_REDIRECT;
}

std::wstring combined(std::wstring const& base, std::wstring const& relative) {
    constexpr DWORD LONGEST = 2083; // the system combines no longer ones
    wchar_t url[LONGEST + 1] = L"";
    DWORD size = LONGEST;
    return SUCCEEDED(UrlCombineW(base.c_str(), relative.c_str(), url, &size, 0)) ? url : std::wstring{};
}

enum class Outcome { GOOD, FAILED, LEADS_ON };

/// \param url  where to ask; then, where the answer leads
Outcome fetchOnce(HINTERNET session, FetchRequest const& wanted, std::wstring& url, BodySink& sink) {
    std::optional<Address> const address = addressOf(url, wanted);
    if (!address.has_value()) return Outcome::FAILED;
    Handle const connection{WinHttpConnect(session, address->host.c_str(), address->port, 0)};
    Handle const request = connection == nullptr ? Handle{} : openRequest(connection.get(), *address);
    if (request == nullptr) return Outcome::FAILED;
    DWORD const status = exchangeWithCredentials(request.get(), *address);
    if (leadsOn(status)) {
        std::wstring const location = header(request.get(), WINHTTP_QUERY_LOCATION);
        url = combined(url, location);
        if (!location.empty()) return Outcome::LEADS_ON;
    }
    // Without any status the system has said why.
    bool const isGood = status >= 200 && status < 300;
    if (!isGood && status != 0) failForStatus(static_cast<long>(status));
    return isGood && readBody(request.get(), sink) ? Outcome::GOOD : Outcome::FAILED;
}

bool isSameServer(std::wstring const& a, std::wstring const& b, FetchRequest const& request) {
    std::optional<Address> const first = addressOf(a, request);
    std::optional<Address> const second = addressOf(b, request);
    return first.has_value() && second.has_value() && first->host == second->host && first->port == second->port;
}

} // namespace

bool fetch(FetchRequest const& wanted, BodySink& sink) {
    Handle const session = openSession(wanted);
    FetchRequest request = wanted;
    std::wstring url = wide(wanted.url, CP_UTF8);
    Outcome outcome = session == nullptr ? Outcome::FAILED : Outcome::LEADS_ON;
    for (std::uint32_t i = 0; i <= MOST_REDIRECTS && outcome == Outcome::LEADS_ON; ++i) {
        std::wstring const asked = url;
        outcome = fetchOnce(session.get(), request, url, sink);
        if (outcome == Outcome::LEADS_ON && !isSameServer(asked, url, request)) {
            // Name and password are for the server that was named, not for one to which it leads on.
            request.user = nullptr;
        }
    }
    return outcome == Outcome::GOOD || (outcome == Outcome::LEADS_ON && failFor(Reason::TOO_MANY_STEPS));
}

} // namespace host
