/// \file
/// `VDPTempDir`: a temporary folder for a job. The constructor makes it; the destructor removes it unless told
/// otherwise.
///
/// All folders lie in one common folder, by default the temporary folder (`Sys::temp()`). Their names are a number that
/// the process counts up and the suffix ".r": "1.r", "2.r" and so on. An instance of the component that shares the
/// temporary folder with others first calls `Init` with its own number: from then on its folders lie in the sub-folder
/// "vdp_tmp" and have that number after the suffix, as in "12.r3".
///
/// Two programs with the same root share their folders unless each calls `Init` with its own number. Both then begin
/// with "tmp/1.r", the second uses the first one's folder with all its contents (`temp-02`), and the job that ends
/// first removes it while the other still uses it. The same holds for two runs of one program, and for programs without
/// a root that are started in the same folder.
///
///     VDPTempDir folder;
///     render(folder.path()); // the folder is removed at the end of the scope
///
/// The class may be used until the process ends, including in static destructors.
///
/// \thread thread-safe: one thread at a time makes a folder, and one process of a user at a time chooses its common
///     folder. `Init` does not wait for a `Create` that is still trying; from then on that call tries names of the new
///     kind. If the platform layer cannot make a mutex, one thread at a time may call. An object belongs to one thread
///     at a time

#ifndef ZOR_BASIS_SYSTEM_VDP_TEMP_DIR_H
#define ZOR_BASIS_SYSTEM_VDP_TEMP_DIR_H

#include "zor_basis/export.h"
#include "zor_basis/files/f_path.h"
#include "zor_basis/text/buf_str.h"

#include <atomic>
#include <cstdint>

namespace ZOR_Basis {

class ZB_API VDPTempDir {
public:
    /// Chooses the common folder, once per process.
    /// \param n  is the instance's number. Instance 1, which starts before the others, removes "vdp_tmp" with all its
    ///     contents and makes it again, with its parents. 0 and negative numbers keep the temporary folder itself
    /// \kept temp-01: the first positive number is final, and 0 changes nothing once a folder has been chosen
    static void Init(int n);

    /// Makes a folder under a new name.
    /// \param path  receives the folder's path
    /// \kept temp-02: an existing folder of that name is used as it is, with its contents; any other entry is left
    ///     alone, and the next number is tried
    /// \kept temp-03: the call tries until it has a folder: if none can be made it never returns, and no other thread
    ///     gets a folder either
    static void Create(FPath& path);

    /// Returns the common folder; the empty path until `Init` or the first folder. The reference stays valid as long as
    /// the process.
    /// \thread not while another thread is in `Init` or makes the first folder
    static FPath const& Root();

    /// Makes a folder by `Create`.
    VDPTempDir() : VDPTempDir(true) {}
    VDPTempDir(bool deleteOnDestroy) : deletes_(deleteOnDestroy) { Create(path_); }
    /// \kept temp-04: a copy has the same folder and also deletes it, so one of the two must be told not to
    ///     (`deleteOnDestroy`)
    VDPTempDir(VDPTempDir const& other) = default;
    /// The same; the folder that this object had before is left behind.
    VDPTempDir& operator=(VDPTempDir const& other) = default;
    /// Removes the folder with all its contents if the object deletes it and the path is a directory.
    ~VDPTempDir();

    /// Sets whether the destructor removes the folder.
    void deleteOnDestroy(bool deletes) { deletes_ = deletes; }
    FPath const& path() const { return path_; }
    /// Tells whether an entry of any kind exists at the path.
    bool status() const;

private:
    static void choose(int n);
    static void prepare();
    static void nextPath(FPath& path);

    static FPath& _GlbTmp;
    static BufStr<15>& _CurName;
    static BufStr<15>& _ExtRip;
    static std::atomic<std::uint64_t> _Sem;
    static std::atomic<std::int32_t> _Level;

    bool deletes_;
    FPath path_;
};

} // namespace ZOR_Basis

#endif
