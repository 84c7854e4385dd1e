/// \file
/// The entries of one directory as the system gives them. Twins: raw_listing_posix.cpp, raw_listing_win.cpp.

#ifndef HOST_XOS_BASICS_DIRECTORIES_RAW_LISTING_H
#define HOST_XOS_BASICS_DIRECTORIES_RAW_LISTING_H

#include <memory>

namespace host {

class RawListing {
public:
    /// \return null, with the system's last error, when the path leads to no directory that can be listed
    static std::unique_ptr<RawListing> open(char const* path);

    RawListing() = default;
    RawListing(RawListing const&) = delete;
    RawListing& operator=(RawListing const&) = delete;
    virtual ~RawListing() = default;

    /// Goes on to the next entry but "." and "..".
    /// \return its name, valid until the next call; null: there is none
    virtual char const* next() = 0;
    /// Whether the entry is a directory; a link is none, wherever it leads.
    virtual bool isDirectory() = 0;
};

} // namespace host

#endif
