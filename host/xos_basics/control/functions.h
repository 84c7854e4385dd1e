/// \file
/// Every function of the platform layer by number, with its name, the kinds of its arguments and whether it can fail.

#ifndef HOST_XOS_BASICS_CONTROL_FUNCTIONS_H
#define HOST_XOS_BASICS_CONTROL_FUNCTIONS_H

#include <array>
#include <cstddef>
#include <cstdint>

namespace host {

/// X(enumerator, name, argument kinds, can it fail). Kinds, one letter an argument: `t` text, `d` signed decimal,
/// `u` unsigned decimal, `x` hexadecimal (flags and handles), `p` address.
#define HOST_FUNCTIONS(X)                                                                                              \
    X(xos_SemMCreate, "xos_SemMCreate", "", true)                                                                      \
    X(xos_SemBCreate, "xos_SemBCreate", "d", true)                                                                     \
    X(xos_SemNamedMutexCreate, "xos_SemNamedMutexCreate", "dxdp", true)                                                \
    X(xos_SemTake, "xos_SemTake", "x", true)                                                                           \
    X(xos_SemGive, "xos_SemGive", "x", true)                                                                           \
    X(xos_SemDestroy, "xos_SemDestroy", "x", true)                                                                     \
    X(xos_TaskCreate, "xos_TaskCreate", "ppxdutu", true)                                                               \
    X(xos_TaskSleep, "xos_TaskSleep", "u", false)                                                                      \
    X(xos_MsCount, "xos_MsCount", "", false)                                                                           \
    X(xos_FileOpen, "xos_FileOpen", "tx", true)                                                                        \
    X(xos_FileCloseEx, "xos_FileCloseEx", "xd", true)                                                                  \
    X(xos_FileReadEx, "xos_FileReadEx", "xpudd", true)                                                                 \
    X(xos_FileWriteEx, "xos_FileWriteEx", "xpudd", true)                                                               \
    X(xos_FileGetsEx, "xos_FileGetsEx", "xpud", true)                                                                  \
    X(xos_FileFlush, "xos_FileFlush", "x", true)                                                                       \
    X(xos_FileSeekEx, "xos_FileSeekEx", "xddd", true)                                                                  \
    X(xos_FileTellEx, "xos_FileTellEx", "xd", true)                                                                    \
    X(xos_FileRemove, "xos_FileRemove", "tx", true)                                                                    \
    X(xos_FileCopy, "xos_FileCopy", "ttd", true)                                                                       \
    X(xos_FileMove, "xos_FileMove", "ttd", true)                                                                       \
    X(xos_FileHardLink, "xos_FileHardLink", "tt", true)                                                                \
    X(xos_FileStatByNameEx, "xos_FileStatByNameEx", "tpx", true)                                                       \
    X(xos_DirCreateEx, "xos_DirCreateEx", "td", true)                                                                  \
    X(xos_DirRemove, "xos_DirRemove", "tx", true)                                                                      \
    X(xos_DirCopy, "xos_DirCopy", "ttx", true)                                                                         \
    X(xos_DirMove, "xos_DirMove", "ttx", true)                                                                         \
    X(xos_DirOpenEx, "xos_DirOpenEx", "ttx", true)                                                                     \
    X(xos_DirForceCaseAny, "xos_DirForceCaseAny", "xd", false)                                                         \
    X(xos_DirNextEx, "xos_DirNextEx", "xddx", true)                                                                    \
    X(xos_DirClose, "xos_DirClose", "x", false)                                                                        \
    X(xos_StrCmp, "xos_StrCmp", "tt", false)                                                                           \
    X(xos_FileSystemRoot, "xos_FileSystemRoot", "", true)                                                              \
    X(xos_ShellExecuteEx, "xos_ShellExecuteEx", "tp", true)                                                            \
    X(xos_LibraryLoad, "xos_LibraryLoad", "t", true)                                                                   \
    X(xos_BasicsParamLookup, "xos_BasicsParamLookup", "xpu", true)                                                     \
    X(xos_Assert, "xos_Assert", "dtt", false)                                                                          \
    X(cfg_GroupLoadFromFile, "cfg_GroupLoadFromFile", "tddd", true)                                                    \
    X(cfg_KeyGetOpt_Bool, "cfg_KeyGetOpt_Bool", "ptd", true)                                                           \
    X(cfg_GroupDelete, "cfg_GroupDelete", "pd", false)                                                                 \
    X(xos_URLGet, "xos_URLGet", "tttt", true)                                                                          \
    X(HQ_Basis_AlertTimer_New, "HQ_Basis::AlertTimer::New", "upp", true)                                               \
    X(HQ_Basis_AlertTimer_Delete, "HQ_Basis::AlertTimer::Delete", "u", true)

enum class Function : std::uint8_t {
#define HOST_ENUMERATOR(id, name, kinds, fails) id,
    HOST_FUNCTIONS(HOST_ENUMERATOR)
#undef HOST_ENUMERATOR
        none
};

struct FunctionFacts {
    char const* name;
    char const* kinds;
    bool canFail;
};

constexpr std::size_t FUNCTION_COUNT = static_cast<std::size_t>(Function::none);
constexpr std::size_t MAX_ARGUMENTS = 7;

inline constexpr std::array<FunctionFacts, FUNCTION_COUNT> FUNCTIONS{{
#define HOST_FACTS(id, name, kinds, fails) FunctionFacts{name, kinds, fails},
    HOST_FUNCTIONS(HOST_FACTS)
#undef HOST_FACTS
}};

constexpr std::size_t indexOf(Function function) { return static_cast<std::size_t>(function); }

constexpr FunctionFacts const& factsOf(Function function) { return FUNCTIONS[indexOf(function)]; }

/// \return `Function::none` when there is no function of that name, or `name` is null
Function functionNamed(char const* name);

} // namespace host

#endif
