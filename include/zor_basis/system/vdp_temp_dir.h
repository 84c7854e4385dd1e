/// \file
/// `VDPTempDir`: a folder of its own for a job, made with the object and, unless told otherwise, gone with it.
///
/// The folders lie in one common folder and are called after a number that the process counts up, with the suffix ".r":
/// "1.r", "2.r" and so on in the temporary folder (`Sys::temp()`). An instance of the component that shares this folder
/// with others calls `Init` with a number of its own first: from then on its folders lie in "vdp_tmp" there and have that
/// number behind the suffix, as "12.r3".
///
/// Two programs with one root share their folders unless each calls `Init` with a number of its own: both then begin with
/// "tmp/1.r", the second uses the first one's folder with all that lies in it (`temp-02`), and whichever job ends first
/// removes it under the other. That holds for two runs of one program, too, and for programs without a root that are started
/// in one folder.
///
/// The class may be used until the process ends, in static destructors too.
///
/// \thread  thread-safe: one thread at a time makes a folder, and one process of a user at a time chooses its common
///     folder. `Init` does not wait for a `Create` that still tries; from then on that one tries names of the new kind.
///     Where the platform layer makes no mutex, one thread at a time may call. An object belongs to one thread at a time

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
    /// Chooses the common folder, once in a process.
    /// \param n  the instance's number; 1, which starts before the others, has "vdp_tmp" removed with all that is in it and
    ///        made anew, with its parents. 0 and below keep the temporary folder itself
    /// \kept temp-01: the first positive number stays, and 0 changes nothing where a folder has been chosen
    static void Init(int n);

    /// Makes a folder under a new name.
    /// \param path  receives it
    /// \kept temp-02: a folder that has the name already is used as it is, with what lies in it; any other entry is left
    ///     alone, and the next number tried
    /// \kept temp-03: tries on until a folder is there: where none can ever be made the call does not return, and no other
    ///     thread gets a folder either
    static void Create(FPath& path);

    /// The common folder; the empty path before `Init` and the first folder. The reference lives as long as the process.
    /// \thread  not while another thread is in `Init` or makes the first folder
    static FPath const& Root();

    /// Makes a folder by `Create`.
    VDPTempDir() : VDPTempDir(true) {}
    VDPTempDir(bool deleteOnDestroy) : deletes_(deleteOnDestroy) { Create(path_); }
    /// \kept temp-04: a copy has the same folder and deletes it too, so one of the two gives that up
    VDPTempDir(VDPTempDir const& other) = default;
    /// The same; a folder that this object had is left behind.
    VDPTempDir& operator=(VDPTempDir const& other) = default;
    /// Removes the folder with all that is in it, where it deletes and a directory is there.
    ~VDPTempDir();

    /// Says whether the folder goes with the object.
    void deleteOnDestroy(bool deletes) { deletes_ = deletes; }
    FPath const& path() const { return path_; }
    /// Whether there is an entry of any kind at the path.
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
