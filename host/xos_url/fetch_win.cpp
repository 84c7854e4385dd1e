// Sibling: fetch_posix.cpp.

#include "host/windows_api.h"
#include "host/xos_url/fetch.h"

#include <memory>
#include <optional>
#include <string>
#include <vector>
#include <winhttp.h>

namespace host {

namespace {

struct CloseInternet {
    using pointer = HINTERNET;
    void operator()(HINTERNET handle) const { WinHttpCloseHandle(handle); }
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

std::optional<Address> addressOf(FetchRequest const& request) {
    std::wstring url = wide(request.url, CP_UTF8);
    url.resize(url.find(L'#') == std::wstring::npos ? url.size() : url.find(L'#'));
    URL_COMPONENTS parts{};
    parts.dwStructSize = sizeof parts;
    // Asks for pointers into the URL.
    parts.dwHostNameLength = parts.dwUrlPathLength = parts.dwExtraInfoLength = DWORD(-1);
    parts.dwUserNameLength = parts.dwPasswordLength = DWORD(-1);
    if (WinHttpCrackUrl(url.c_str(), static_cast<DWORD>(url.size()), 0, &parts) == FALSE) { return std::nullopt; }
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
        setNumber(request.get(), WINHTTP_OPTION_REDIRECT_POLICY, WINHTTP_OPTION_REDIRECT_POLICY_ALWAYS);
        setNumber(request.get(), WINHTTP_OPTION_MAX_HTTP_AUTOMATIC_REDIRECTS, MOST_REDIRECTS);
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
        if ((offered & scheme) != 0) { return scheme; }
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

std::optional<std::uint64_t> announcedLength(HINTERNET request) {
    wchar_t digits[32] = L"";
    DWORD size = sizeof digits - sizeof(wchar_t);
    if (WinHttpQueryHeaders(request, WINHTTP_QUERY_CONTENT_LENGTH, WINHTTP_HEADER_NAME_BY_INDEX, digits, &size,
                            WINHTTP_NO_HEADER_INDEX) == FALSE) {
        return std::nullopt;
    }
    return std::wcstoull(digits, nullptr, 10);
}

/// A connection that ends early reads like the end of the body, so the length is compared.
bool readBody(HINTERNET request, BodySink& sink) {
    std::optional<std::uint64_t> const announced = announcedLength(request);
    std::vector<char> piece(65536);
    std::uint64_t received = 0;
    for (;;) {
        DWORD count = 0;
        if (WinHttpReadData(request, piece.data(), static_cast<DWORD>(piece.size()), &count) == FALSE) { return false; }
        if (count == 0) { return !announced.has_value() || *announced == received; }
        received += count;
        if (!sink.take(piece.data(), count)) { return false; }
    }
}

} // namespace

bool fetch(FetchRequest const& wanted, BodySink& sink) {
    std::optional<Address> const address = addressOf(wanted);
    if (!address.has_value()) { return false; }
    Handle const session = openSession(wanted);
    if (session == nullptr) { return false; }
    Handle const connection{WinHttpConnect(session.get(), address->host.c_str(), address->port, 0)};
    if (connection == nullptr) { return false; }
    Handle const request = openRequest(connection.get(), *address);
    if (request == nullptr) { return false; }
    DWORD const status = exchangeWithCredentials(request.get(), *address);
    return status >= 200 && status < 300 && readBody(request.get(), sink);
}

} // namespace host
