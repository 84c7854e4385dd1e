/// \file
/// Every function of the platform layer by number, with its name, the kinds of its arguments and what it is like.

#ifndef HOST_XOS_BASICS_CONTROL_FUNCTIONS_H
#define HOST_XOS_BASICS_CONTROL_FUNCTIONS_H

#include <array>
#include <cstddef>
#include <cstdint>
#include <string_view>

namespace host {

/// It can be made to fail.
constexpr unsigned CAN_FAIL = 1;
/// Most of its calls need no system call and take less time than a cache line from one processor to another.
constexpr unsigned IS_QUICK = 2;

/// X(enumerator, name, argument kinds, result kind, traits). Kinds, one letter for each argument: `t` text, `l` URL,
/// `s` secret text, `d` signed decimal, `u` unsigned decimal, `x` hexadecimal (flags and handles), `p` address; of a
/// result also `v`, none.
#define HOST_FUNCTIONS(X)                                                                                              \
    X(xos_SemMCreate, "xos_SemMCreate", "", 'x', CAN_FAIL | IS_QUICK)                                                  \
    X(xos_SemBCreate, "xos_SemBCreate", "d", 'x', CAN_FAIL | IS_QUICK)                                                 \
    X(xos_SemNamedMutexCreate, "xos_SemNamedMutexCreate", "dxdp", 'x', CAN_FAIL)                                       \
    X(xos_SemTake, "xos_SemTake", "x", 'd', CAN_FAIL | IS_QUICK)                                                       \
    X(xos_SemGive, "xos_SemGive", "x", 'd', CAN_FAIL | IS_QUICK)                                                       \
    X(xos_SemDestroy, "xos_SemDestroy", "x", 'd', CAN_FAIL | IS_QUICK)                                                 \
    X(xos_TaskCreate, "xos_TaskCreate", "ppxdutu", 'x', CAN_FAIL)                                                      \
    X(xos_TaskSleep, "xos_TaskSleep", "u", 'v', 0)                                                                     \
    X(xos_MsCount, "xos_MsCount", "", 'u', IS_QUICK)                                                                   \
    X(xos_FileOpen, "xos_FileOpen", "tx", 'x', CAN_FAIL)                                                               \
    X(xos_FileCloseEx, "xos_FileCloseEx", "xd", 'd', CAN_FAIL)                                                         \
    X(xos_FileReadEx, "xos_FileReadEx", "xpudd", 'u', CAN_FAIL | IS_QUICK)                                             \
    X(xos_FileWriteEx, "xos_FileWriteEx", "xpudd", 'u', CAN_FAIL)                                                      \
    X(xos_FileGetsEx, "xos_FileGetsEx", "xpud", 'p', CAN_FAIL | IS_QUICK)                                              \
    X(xos_FileFlush, "xos_FileFlush", "x", 'd', CAN_FAIL)                                                              \
    X(xos_FileSeekEx, "xos_FileSeekEx", "xddd", 'd', CAN_FAIL)                                                         \
    X(xos_FileTellEx, "xos_FileTellEx", "xd", 'd', CAN_FAIL)                                                           \
    X(xos_FileRemove, "xos_FileRemove", "tx", 'd', CAN_FAIL)                                                           \
    X(xos_FileCopy, "xos_FileCopy", "ttd", 'd', CAN_FAIL)                                                              \
    X(xos_FileMove, "xos_FileMove", "ttd", 'd', CAN_FAIL)                                                              \
    X(xos_FileHardLink, "xos_FileHardLink", "tt", 'd', CAN_FAIL)                                                       \
    X(xos_FileStatByNameEx, "xos_FileStatByNameEx", "tpx", 'd', CAN_FAIL)                                              \
    X(xos_DirCreateEx, "xos_DirCreateEx", "td", 'd', CAN_FAIL)                                                         \
    X(xos_DirRemove, "xos_DirRemove", "tx", 'd', CAN_FAIL)                                                             \
    X(xos_DirCopy, "xos_DirCopy", "ttx", 'd', CAN_FAIL)                                                                \
    X(xos_DirMove, "xos_DirMove", "ttx", 'd', CAN_FAIL)                                                                \
    X(xos_DirOpenEx, "xos_DirOpenEx", "ttx", 'x', CAN_FAIL)                                                            \
    X(xos_DirForceCaseAny, "xos_DirForceCaseAny", "xd", 'v', 0)                                                        \
    X(xos_DirNextEx, "xos_DirNextEx", "xddx", 't', CAN_FAIL | IS_QUICK)                                                \
    X(xos_DirClose, "xos_DirClose", "x", 'v', 0)                                                                       \
    X(xos_StrCmp, "xos_StrCmp", "tt", 'd', IS_QUICK)                                                                   \
    X(xos_FileSystemRoot, "xos_FileSystemRoot", "", 't', CAN_FAIL)                                                     \
    X(xos_ShellExecuteEx, "xos_ShellExecuteEx", "tp", 'd', CAN_FAIL)                                                   \
    X(xos_LibraryLoad, "xos_LibraryLoad", "t", 'p', CAN_FAIL)                                                          \
    X(xos_BasicsParamLookup, "xos_BasicsParamLookup", "xpu", 'd', CAN_FAIL)                                            \
    X(xos_Assert, "xos_Assert", "dtt", 'v', 0)                                                                         \
    X(cfg_GroupLoadFromFile, "cfg_GroupLoadFromFile", "tddd", 'p', CAN_FAIL)                                           \
    X(cfg_KeyGetOpt_Bool, "cfg_KeyGetOpt_Bool", "ptd", 'd', CAN_FAIL | IS_QUICK)                                       \
    X(cfg_GroupDelete, "cfg_GroupDelete", "pd", 'v', 0)                                                                \
    X(xos_URLGet, "xos_URLGet", "ltts", 'd', CAN_FAIL)                                                                 \
    X(HQ_Basis_AlertTimer_New, "HQ_Basis::AlertTimer::New", "upp", 'u', CAN_FAIL)                                      \
    X(HQ_Basis_AlertTimer_Delete, "HQ_Basis::AlertTimer::Delete", "u", 'v', CAN_FAIL)

enum class Function : std::uint8_t {
#define HOST_ENUMERATOR(id, name, kinds, result, traits) id,
    HOST_FUNCTIONS(HOST_ENUMERATOR)
#undef HOST_ENUMERATOR
        NONE
};

constexpr std::size_t FUNCTION_COUNT = static_cast<std::size_t>(Function::NONE);
constexpr std::size_t MAX_ARGUMENTS = 7;

constexpr bool isText(char kind) { return kind == 't' || kind == 'l' || kind == 's'; }

struct FunctionFacts {
    std::string_view name;
    std::string_view kinds;
    char result;
    unsigned traits;
    bool hasTexts = kinds.find_first_of("tls") != std::string_view::npos;
};

inline constexpr std::array<FunctionFacts, FUNCTION_COUNT> FUNCTIONS{{
#define HOST_FACTS(id, name, kinds, result, traits) FunctionFacts{name, kinds, result, traits},
    HOST_FUNCTIONS(HOST_FACTS)
#undef HOST_FACTS
}};

constexpr std::size_t indexOf(Function function) { return static_cast<std::size_t>(function); }

constexpr FunctionFacts const& factsOf(Function function) { return FUNCTIONS[indexOf(function)]; }

/// \return `Function::NONE` if there is no function of that name, or if `name` is null
constexpr Function functionNamed(char const* name) {
    std::size_t index = 0;
    while (index < FUNCTION_COUNT && (name == nullptr || FUNCTIONS[index].name != name)) { ++index; }
    return static_cast<Function>(index);
}

} // namespace host

#endif
