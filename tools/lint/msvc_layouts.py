"""What clang says about the classes that the library exports, for MSVC's target and for the other compilers' one.

Virtual functions must have the same slots with both: MSVC gives overloads of one name their slots backwards. And where
an exported class consists of parts that are not exported, MSVC warns each program that includes the header, unless the
class stands between ZB_INLINE_PARTS_BEGIN and ZB_INLINE_PARTS_END.
"""

import re

import common
import msvc_target

EXPORTED = re.compile(r"^(?:class|struct) ZB_API(?:_\w+)? (\w+)", re.M)
SILENT = re.compile(r"^ZB_INLINE_PARTS_BEGIN$(.*?)^ZB_INLINE_PARTS_END$", re.M | re.S)
OTHER_COMPILERS = ["--target=x86_64-linux-gnu", "-std=c++20"]
# A class with one more virtual function makes clang lay out the table of its base.
SLOTS = """
#include <type_traits>
template <class T, bool>
struct Slots {};
template <class T>
struct Slots<T, true> : T {
    virtual void oneMore();
};
template <class T>
void Slots<T, true>::oneMore() {}
using namespace ZOR_Basis;
"""


def exported_classes(headers):
    return sorted({name for header in headers for name in EXPORTED.findall(header)})


def layouts(target, names, classes):
    """Clang's descriptions of all tables and records, or its errors."""
    uses = "".join(f"template struct Slots<{name}, std::is_polymorphic_v<{name}>>;\n" for name in classes)
    return msvc_target.clang(*target, "-Xclang", "-fdump-vtable-layouts", "-Xclang", "-fdump-record-layouts-complete",
                             "-c", "-o", "/dev/null", text=msvc_target.including(*names) + SLOTS + uses)


def slots(described):
    """{class: the functions of its table, in order}; a destructor has two slots next to each other or one."""
    found = {}
    for table in re.findall(r"^VF?Table for .*\n((?:.+\n)+)", described, re.M | re.I):
        functions = re.findall(r"^ +\d+ \| (?!.* RTTI|offset_to_top)(.*)$", table, re.M)
        if functions and (last := re.match(r"void Slots<(.*), true>::oneMore", functions[-1])):
            plain = [re.sub(r"[\w:<>, ]*::~\w+\(\).*", "destructor", f).replace(" [pure]", "") for f in functions[:-1]]
            found[last[1]] = [f for number, f in enumerate(plain) if plain[number - 1:number] != [f]]
    return found


def differing_slots(msvc, others):
    if not msvc or msvc.keys() != others.keys():
        return [f"tables of other classes with MSVC: {sorted(msvc)}, otherwise: {sorted(others)}"]
    return [f"{name}: slots {' | '.join(msvc[name])} with MSVC, otherwise {' | '.join(others[name])}"
            for name in sorted(msvc) if msvc[name] != others[name]]


def foreign_parts(described, exported):
    """{exported class: its bases and members whose classes are not exported}. A base that is made from a template is
    exported with the class."""
    found = {}
    for record in described.split("*** Dumping AST Record Layout")[1:]:
        classes = re.findall(r"^ +[\d:-]+ \| (?:  )?(?:class|struct|union) (?:ZOR_Basis::)?(.*)$", record, re.M)
        name = "".join(classes[:1])
        for part in classes[1:] if name in exported else []:
            is_template_base = "<" in part and "(base)" in part
            if not is_template_base and re.match(r"[\w:]+", part)[0] not in exported:
                found.setdefault(name, []).append(part)
    return found


def unmarked_parts(described, headers):
    exported = set(exported_classes(headers)) | {"BufStr"}
    silent = {name for header in headers for text in SILENT.findall(header) for name in EXPORTED.findall(text)}
    parts = foreign_parts(described, exported)
    return ([f"{name}: MSVC warns programs of its part {parts[name][0]}" for name in sorted(parts.keys() - silent)] +
            [f"{name}: MSVC has nothing to warn of" for name in sorted(silent - parts.keys())])


def problems(names):
    headers = [common.text(f"include/{name}") for name in names]
    classes = exported_classes(headers)
    msvc = layouts(msvc_target.CXX, names, classes)
    others = layouts(OTHER_COMPILERS, names, classes)
    if msvc.returncode or others.returncode:
        return [msvc.stderr + others.stderr]
    return differing_slots(slots(msvc.stdout), slots(others.stdout)) + unmarked_parts(msvc.stdout, headers)
