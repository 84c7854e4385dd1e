// The sibling is raw_listing_posix.cpp.

#include "host/xos_basics/directories/raw_listing.h"

#include "host/xos_basics/files/path_win.h"
#include "host/xos_basics/files/search_win.h"

namespace host {

namespace {

class SearchListing final : public RawListing {
public:
    bool open(std::wstring const& directory) { return search_.open(directory); }

    char const* next() override {
        while (search_.next()) {
            if (narrow(search_.name()) || narrow(search_.entry().cAlternateFileName)) return name_;
        }
        return nullptr;
    }
    bool isDirectory() override { return search_.isDirectory(); }

private:
    /// \return false for a name that the code page cannot express
    bool narrow(wchar_t const* name) {
        // In UTF-8 nothing is ever replaced, and the system refuses to be asked for it.
        BOOL replaced = FALSE;
        bool const utf8 = GetACP() == CP_UTF8;
        DWORD const flags = utf8 ? WC_ERR_INVALID_CHARS : WC_NO_BEST_FIT_CHARS;
        return *name != 0 &&
               WideCharToMultiByte(CP_ACP, flags, name, -1, name_, sizeof name_, nullptr, utf8 ? nullptr : &replaced) !=
                   0 &&
               replaced == FALSE;
    }

    Search search_;
    char name_[MAX_PATH * 4];
};

} // namespace

std::unique_ptr<RawListing> RawListing::open(char const* path) {
    std::wstring directory;
    auto listing = std::make_unique<SearchListing>();
    if (!fullPath(path, directory) || !listing->open(directory)) return nullptr;
    return listing;
}

} // namespace host
