/// \file
/// The registry and the table of the system's calls as a test wants them, and at its end as they were.

#ifndef TESTS_SYSTEM_REGISTRY_SCRATCH_WIN_H
#define TESTS_SYSTEM_REGISTRY_SCRATCH_WIN_H

#include "basis/system/query_calls_win.h"

#include <gtest/gtest.h>

#include <functional>
#include <string>
#include <vector>

constexpr char EXPLORER[] = "Software\\Microsoft\\Windows\\CurrentVersion\\Explorer";
constexpr char VOLATILE[] = "Volatile Environment";
constexpr char WINLOGON[] = "SOFTWARE\\Microsoft\\Windows NT\\CurrentVersion\\Winlogon";
constexpr char DOMAIN_CACHE[] = "SOFTWARE\\Microsoft\\Windows NT\\CurrentVersion\\Winlogon\\DomainCache";
constexpr char MOUNTED_DEVICES[] = "SYSTEM\\MountedDevices";

/// Keys that are opened and closed while a test runs.
inline long keysOpened = 0;
inline long keysClosed = 0;
inline ZOR_Basis::QueryCalls const realCalls = ZOR_Basis::queryCalls;

inline LSTATUS WINAPI openCounted(HKEY parent, char const* path, DWORD options, REGSAM access, HKEY* key) {
    EXPECT_EQ(access & (KEY_SET_VALUE | KEY_CREATE_SUB_KEY | KEY_CREATE_LINK), 0u)
        << "keys are opened for queries only";
    LSTATUS const result = realCalls.openKey(parent, path, options, access, key);
    keysOpened += result == ERROR_SUCCESS ? 1 : 0;
    return result;
}

inline LSTATUS WINAPI closeCounted(HKEY key) {
    LSTATUS const result = realCalls.closeKey(key);
    keysClosed += result == ERROR_SUCCESS ? 1 : 0;
    return result;
}

struct RegistryScratch : testing::Test {
    RegistryScratch() {
        keysOpened = keysClosed = 0;
        ZOR_Basis::queryCalls.openKey = openCounted;
        ZOR_Basis::queryCalls.closeKey = closeCounted;
    }
    ~RegistryScratch() override {
        EXPECT_EQ(keysOpened, keysClosed);
        ZOR_Basis::queryCalls = realCalls;
        for (; !undo_.empty(); undo_.pop_back()) undo_.back()();
    }

    void makeKey(HKEY root, std::string const& path) {
        // The deletion of the topmost new key takes the others along.
        for (std::size_t end = 0; end != std::string::npos;) {
            end = path.find('\\', end + 1);
            std::string const part = path.substr(0, end);
            HKEY key = nullptr;
            if (RegOpenKeyExA(root, part.c_str(), 0, KEY_READ, &key) == ERROR_SUCCESS) {
                RegCloseKey(key);
                continue;
            }
            undo_.push_back([=] { RegDeleteTreeA(root, part.c_str()); });
            break;
        }
        HKEY key = nullptr;
        ASSERT_EQ(RegCreateKeyExA(root, path.c_str(), 0, nullptr, 0, KEY_ALL_ACCESS, nullptr, &key, nullptr),
                  ERROR_SUCCESS)
            << path;
        RegCloseKey(key);
    }

    /// Sets a value to these very bytes.
    void setBytes(HKEY root, std::string const& path, std::string const& value, DWORD type, std::string const& bytes) {
        makeKey(root, path);
        keepValue(root, path, value);
        // The wide form stores the bytes as they are, whatever the type.
        std::wstring const wide(value.begin(), value.end());
        HKEY key = nullptr;
        RegOpenKeyExA(root, path.c_str(), 0, KEY_SET_VALUE, &key);
        EXPECT_EQ(RegSetValueExW(key, wide.c_str(), 0, type, reinterpret_cast<BYTE const*>(bytes.data()),
                                 static_cast<DWORD>(bytes.size())),
                  ERROR_SUCCESS);
        RegCloseKey(key);
    }

    /// Sets a value to a text in ASCII; what is stored has no terminator unless the text has one.
    void setRaw(HKEY root, std::string const& path, std::string const& value, std::string const& text,
                DWORD type = REG_SZ) {
        std::string bytes;
        for (char c : text) bytes += {c, '\0'};
        setBytes(root, path, value, type, bytes);
    }
    void set(HKEY root, std::string const& path, std::string const& value, std::string const& text) {
        setRaw(root, path, value, text + '\0');
    }

    void removeValue(HKEY root, std::string const& path, std::string const& value) {
        keepValue(root, path, value);
        HKEY key = nullptr;
        if (RegOpenKeyExA(root, path.c_str(), 0, KEY_SET_VALUE, &key) != ERROR_SUCCESS) return;
        RegDeleteValueA(key, value.c_str());
        RegCloseKey(key);
    }

private:
    void keepValue(HKEY root, std::string const& path, std::string const& value) {
        HKEY key = nullptr;
        if (RegOpenKeyExA(root, path.c_str(), 0, KEY_READ, &key) != ERROR_SUCCESS) return;
        std::string bytes(100'000, '\0');
        DWORD type = 0, n = static_cast<DWORD>(bytes.size());
        LSTATUS const result =
            RegQueryValueExA(key, value.c_str(), nullptr, &type, reinterpret_cast<BYTE*>(bytes.data()), &n);
        RegCloseKey(key);
        bytes.resize(n);
        undo_.push_back([=] {
            HKEY again = nullptr;
            if (RegOpenKeyExA(root, path.c_str(), 0, KEY_SET_VALUE, &again) != ERROR_SUCCESS) return;
            if (result == ERROR_SUCCESS) {
                RegSetValueExA(again, value.c_str(), 0, type, reinterpret_cast<BYTE const*>(bytes.data()), n);
            } else {
                RegDeleteValueA(again, value.c_str());
            }
            RegCloseKey(again);
        });
    }

    std::vector<std::function<void()>> undo_;
};

#endif
