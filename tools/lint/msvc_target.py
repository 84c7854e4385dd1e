"""How clang reads a source as MSVC does, without any file of Microsoft's.

Language, sizes, layouts, names and `__declspec` are clang's, which are MSVC's on that target. The standard library is
libc++; the C library and windows.h are mingw-w64's; the headers of tools/lint/msvc fit them together.
"""

import common

CLANG = "clang++-19"
HERE = common.ROOT / "tools/lint/msvc"
INCLUDES = ["-Iinclude", "-Ihost/include", "-I."]
C = ["--target=x86_64-pc-windows-msvc", "-fms-compatibility", "-fms-extensions", "-fms-compatibility-version=19.38",
     "-D_WIN32_WINNT=0x0A00", "-D_CRT_SECURE_NO_WARNINGS", "-nostdlibinc", "-isystem", HERE / "intrinsics",
     "-idirafter", HERE / "system", "-idirafter", "/usr/x86_64-w64-mingw32/include"]


def libcxx():
    """The folder of libc++'s headers that came with the compiler."""
    resources = common.run(CLANG, "-print-resource-dir", check=True).stdout.strip()
    return common.Path(resources).parents[2] / "include/c++/v1"


CXX = [*C, "-std=c++20", "-fcxx-exceptions", "-fexceptions", "-nostdinc++", "-D_LIBCPP_REMOVE_TRANSITIVE_INCLUDES",
       "-isystem", HERE / "library", "-isystem", libcxx()]


def including(*names):
    return "".join(f'#include "{name}"\n' for name in names)


def clang(*flags, text, file="-", language="c++"):
    """Compiles a file, or a text, in the project's folder."""
    return common.run(CLANG, *INCLUDES, *flags, "-x", language, file, input=text)
