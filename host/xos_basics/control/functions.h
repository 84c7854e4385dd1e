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

/// X(enumerator, name, argument kinds, traits). Kinds, one letter for each argument: `t` text, `d` signed decimal,
/// `u` unsigned decimal, `x` hexadecimal (flags and handles), `p` address.
#define HOST_FUNCTIONS(X)                                                                                              \
    X(xos_SemMCreate, "xos_SemMCreate", "", CAN_FAIL | IS_QUICK)                                                       \
    X(xos_SemBCreate, "xos_SemBCreate", "d", CAN_FAIL | IS_QUICK)                                                      \
    X(xos_SemNamedMutexCreate, "xos_SemNamedMutexCreate", "dxdp", CAN_FAIL)                                            \
    X(xos_SemTake, "xos_SemTake", "x", CAN_FAIL | IS_QUICK)                                                            \
    X(xos_SemGive, "xos_SemGive", "x", CAN_FAIL | IS_QUICK)                                                            \
    X(xos_SemDestroy, "xos_SemDestroy", "x", CAN_FAIL | IS_QUICK)                                                      \
    X(xos_TaskCreate, "xos_TaskCreate", "ppxdutu", CAN_FAIL)                                                           \
    X(xos_TaskSleep, "xos_TaskSleep", "u", 0)                                                                          \
    X(xos_MsCount, "xos_MsCount", "", IS_QUICK)                                                                        \
    X(xos_FileOpen, "xos_FileOpen", "tx", CAN_FAIL)                                                                    \
    X(xos_FileCloseEx, "xos_FileCloseEx", "xd", CAN_FAIL)                                                              \
    X(xos_FileReadEx, "xos_FileReadEx", "xpudd", CAN_FAIL | IS_QUICK)                                                  \
    X(xos_FileWriteEx, "xos_FileWriteEx", "xpudd", CAN_FAIL)                                                           \
    X(xos_FileGetsEx, "xos_FileGetsEx", "xpud", CAN_FAIL | IS_QUICK)                                                   \
    X(xos_FileFlush, "xos_FileFlush", "x", CAN_FAIL)                                                                   \
    X(xos_FileSeekEx, "xos_FileSeekEx", "xddd", CAN_FAIL)                                                              \
    X(xos_FileTellEx, "xos_FileTellEx", "xd", CAN_FAIL)                                                                \
    X(xos_FileRemove, "xos_FileRemove", "tx", CAN_FAIL)                                                                \
    X(xos_FileCopy, "xos_FileCopy", "ttd", CAN_FAIL)                                                                   \
    X(xos_FileMove, "xos_FileMove", "ttd", CAN_FAIL)                                                                   \
    X(xos_FileHardLink, "xos_FileHardLink", "tt", CAN_FAIL)                                                            \
    X(xos_FileStatByNameEx, "xos_FileStatByNameEx", "tpx", CAN_FAIL)                                                   \
    X(xos_DirCreateEx, "xos_DirCreateEx", "td", CAN_FAIL)                                                              \
    X(xos_DirRemove, "xos_DirRemove", "tx", CAN_FAIL)                                                                  \
    X(xos_DirCopy, "xos_DirCopy", "ttx", CAN_FAIL)                                                                     \
    X(xos_DirMove, "xos_DirMove", "ttx", CAN_FAIL)                                                                     \
    X(xos_DirOpenEx, "xos_DirOpenEx", "ttx", CAN_FAIL)                                                                 \
    X(xos_DirForceCaseAny, "xos_DirForceCaseAny", "xd", 0)                                                             \
    X(xos_DirNextEx, "xos_DirNextEx", "xddx", CAN_FAIL | IS_QUICK)                                                     \
    X(xos_DirClose, "xos_DirClose", "x", 0)                                                                            \
    X(xos_StrCmp, "xos_StrCmp", "tt", IS_QUICK)                                                                        \
    X(xos_FileSystemRoot, "xos_FileSystemRoot", "", CAN_FAIL)                                                          \
    X(xos_ShellExecuteEx, "xos_ShellExecuteEx", "tp", CAN_FAIL)                                                        \
    X(xos_LibraryLoad, "xos_LibraryLoad", "t", CAN_FAIL)                                                               \
    X(xos_BasicsParamLookup, "xos_BasicsParamLookup", "xpu", CAN_FAIL)                                                 \
    X(xos_Assert, "xos_Assert", "dtt", 0)                                                                              \
    X(cfg_GroupLoadFromFile, "cfg_GroupLoadFromFile", "tddd", CAN_FAIL)                                                \
    X(cfg_KeyGetOpt_Bool, "cfg_KeyGetOpt_Bool", "ptd", CAN_FAIL | IS_QUICK)                                            \
    X(cfg_GroupDelete, "cfg_GroupDelete", "pd", 0)                                                                     \
    X(xos_URLGet, "xos_URLGet", "tttt", CAN_FAIL)                                                                      \
    X(HQ_Basis_AlertTimer_New, "HQ_Basis::AlertTimer::New", "upp", CAN_FAIL)                                           \
    X(HQ_Basis_AlertTimer_Delete, "HQ_Basis::AlertTimer::Delete", "u", CAN_FAIL)

enum class Function : std::uint8_t {
#define HOST_ENUMERATOR(id, name, kinds, traits) id,
    HOST_FUNCTIONS(HOST_ENUMERATOR)
#undef HOST_ENUMERATOR
        NONE
};

constexpr std::size_t FUNCTION_COUNT = static_cast<std::size_t>(Function::NONE);
constexpr std::size_t MAX_ARGUMENTS = 7;

struct FunctionFacts {
    std::string_view name;
    std::string_view kinds;
    unsigned traits;
    bool hasTexts = kinds.find('t') != std::string_view::npos;
};

inline constexpr std::array<FunctionFacts, FUNCTION_COUNT> FUNCTIONS{{
#define HOST_FACTS(id, name, kinds, traits) FunctionFacts{name, kinds, traits},
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
