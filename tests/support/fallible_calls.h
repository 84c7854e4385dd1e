/// \file
/// The functions of the platform layer that can be made to fail.

#ifndef TESTS_SUPPORT_FALLIBLE_CALLS_H
#define TESTS_SUPPORT_FALLIBLE_CALLS_H

inline constexpr char const* FALLIBLE_CALLS[] = {
    "xos_SemMCreate",
    "xos_SemBCreate",
    "xos_SemNamedMutexCreate",
    "xos_SemTake",
    "xos_SemGive",
    "xos_SemDestroy",
    "xos_TaskCreate",
    "xos_FileOpen",
    "xos_FileCloseEx",
    "xos_FileReadEx",
    "xos_FileWriteEx",
    "xos_FileGetsEx",
    "xos_FileFlush",
    "xos_FileSeekEx",
    "xos_FileTellEx",
    "xos_FileRemove",
    "xos_FileCopy",
    "xos_FileMove",
    "xos_FileHardLink",
    "xos_FileStatByNameEx",
    "xos_DirCreateEx",
    "xos_DirRemove",
    "xos_DirCopy",
    "xos_DirMove",
    "xos_DirOpenEx",
    "xos_DirNextEx",
    "xos_FileSystemRoot",
    "xos_ShellExecuteEx",
    "xos_LibraryLoad",
    "xos_BasicsParamLookup",
    "cfg_GroupLoadFromFile",
    "cfg_KeyGetOpt_Bool",
    "xos_URLGet",
    "HQ_Basis::AlertTimer::New",
    "HQ_Basis::AlertTimer::Delete",
};

#endif
