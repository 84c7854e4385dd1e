"""How gdb shows the values of zor_basis. gdb loads this file with the library, under the name of the library and
-gdb.py; `info pretty-printer` lists the printers."""

import gdb
import gdb.printing

STRING, ARRAY, MAP = "string", "array", "map"


def word(value):
    """The number in a field, which may be atomic."""
    kind = value.type.strip_typedefs()
    if kind.code != gdb.TYPE_CODE_STRUCT:
        return int(value)
    if kind.name.startswith("ZOR_Basis::detail::Statistic<"):
        return word(value["value_"])
    if kind.name == "std::atomic<bool>":
        return int(value["_M_base"]["_M_i"])
    return int(value["_M_i"])


def most_elements():
    """How many elements of a sequence gdb shall show; None: all."""
    return gdb.parameter("print elements")


class Text:
    """A narrow or wide text: what is in it, whether in the object or on the heap."""

    def __init__(self, value, pointer="text_", size="size_"):
        self.text, self.size = value[pointer], word(value[size])

    def to_string(self):
        if self.text == 0:
            return "null" if self.size == 0 else f"null of size {self.size}"
        return self.text.lazy_string(length=self.size)

    def display_hint(self):
        return STRING if self.text != 0 else None


class WideText(Text):
    """Converted here, as some versions of gdb do not survive a lazy string of wide characters."""

    def to_string(self):
        if self.text == 0:
            return super().to_string()
        limit = most_elements()
        count = self.size if limit is None else min(self.size, limit + 1) # one more makes gdb show that there is more
        return self.text.string("utf-16-le", "replace", count)


class AutoPtr(Text):
    def __init__(self, value):
        super().__init__(value, "buffer_", "length_")


class Hashed:
    def __init__(self, value):
        self.value = value

    def to_string(self):
        return f"hash {word(self.value['hash_'])}"

    def children(self):
        yield "text", self.value["text_"]


class Blob:
    """Its bytes as text, those that are no printable ASCII as \\xNN."""

    def __init__(self, value):
        self.value = value

    def described(self, content):
        size, capacity = word(self.value["size_"]), word(self.value["capacity_"])
        if self.value["buffer_"] == 0:
            return "empty" if size == 0 else f"no buffer, size {size}"
        return f"{size} bytes of {capacity}" + (f': {content(size)}' if size != 0 else "")

    def shown(self, size):
        limit = most_elements()
        count = size if limit is None else min(size, limit)
        memory = gdb.selected_inferior().read_memory(int(self.value["buffer_"]), count).tobytes()
        text = "".join(chr(b) if 0x20 <= b < 0x7F and b not in b'"\\' else f"\\x{b:02x}" for b in memory)
        return f'"{text}"' + ("..." if count < size else "")

    def to_string(self):
        return self.described(self.shown)


class Secret(Blob):
    """Logs of debuggers are passed on, so the bytes stay hidden."""

    def to_string(self):
        return self.described(lambda size: "not shown")


class List:
    def __init__(self, value):
        self.value, self.size = value, word(value["count_"]["number"])

    def units(self):
        unit, left = self.value["first_"], self.size
        while unit != 0 and left > 0:
            yield unit["value"]
            unit, left = unit["next"], left - 1

    def to_string(self):
        return "empty" if self.size == 0 else f"{self.size} units"

    def children(self):
        for index, value in enumerate(self.units()):
            yield f"[{index}]", value

    def display_hint(self):
        return ARRAY


class Dict(List):
    def to_string(self):
        changed = ", not saved" if self.value["modified_"] else ""
        return f"{self.size} keys{changed}, file {self.value['path_'].format_string()}"

    def children(self):
        for index, entry in enumerate(self.units()):
            yield f"[{index}] key", entry["key"]
            yield f"[{index}] value", entry["value"]

    def display_hint(self):
        return MAP


class Pointers:
    def __init__(self, value):
        self.value, self.size = value, word(value["count_"])

    def to_string(self):
        return f"{self.size} slots of {word(self.value['capacity_'])}"

    def children(self):
        for index in range(self.size):
            yield f"[{index}]", self.value["slots_"][index]

    def display_hint(self):
        return ARRAY


class Timer:
    """A measurement; its times are in ticks of the performance counter."""

    def __init__(self, value):
        self.value = value

    def state(self):
        if word(self.value["start"]) <= 0:
            return "not started"
        return "suspended" if word(self.value["suspendStart"]) > 0 else "running"

    def to_string(self):
        return self.state()

    def children(self):
        for field in ("start", "stop", "suspendStart", "suspended"):
            if word(self.value[field]) != 0:
                yield field, self.value[field]


class Pile(Timer):
    def to_string(self):
        name = self.value["name_"].format_string()
        return f"{name}, id {word(self.value['id_'])}, {word(self.value['count_'])} times, {self.state()}"

    def children(self):
        for field in ("total_", "suspendTotal_", "max_", "suspendMax_"):
            yield field, word(self.value[field])
        yield from super().children()


class Job:
    def __init__(self, value):
        self.value = value

    def state(self):
        if word(self.value["finished_"]):
            return "returned true" if word(self.value["result_"]) else "returned false"
        return "running" if word(self.value["started_"]) else "waiting"

    def to_string(self):
        return self.state()

    def children(self):
        yield "function", self.value["function_"]
        yield "argument", self.value["argument_"]


PRINTERS = (
    ("Str", r"^ZOR_Basis::Str$", Text),
    ("BufStr", r"^ZOR_Basis::BufStr<.*>$", Text),
    ("HeapStr", r"^ZOR_Basis::HeapStr$", Text),
    ("FPath", r"^ZOR_Basis::FPath$", Text),
    ("WStr", r"^ZOR_Basis::WStr$", WideText),
    ("WBStr", r"^ZOR_Basis::WBStr$", WideText),
    ("WFxStr", r"^ZOR_Basis::WFxStr$", WideText),
    ("WcPath", r"^ZOR_Basis::WcPath$", WideText),
    ("Auto_ptr_CStr", r"^Auto_ptr_CStr$", AutoPtr),
    ("HashedStr", r"^ZOR_Basis::HashedStr<.*>$", Hashed),
    ("Blob", r"^ZOR_Basis::Blob$", Blob),
    ("SecretBlob", r"^ZOR_Basis::SecretBlob$", Secret),
    ("SngList", r"^ZOR_Basis::SngList<.*>$", List),
    ("Dict", r"^ZOR_Basis::Dict<.*>$", Dict),
    ("PtrArray", r"^ZOR_Basis::PtrArray<.*>$", Pointers),
    ("BaseTimer", r"^ZOR_Basis::BaseTimer$", Timer),
    ("PileTimer", r"^ZOR_Basis::PileTimer(MT)?$", Pile),
    ("MTQ_Dat", r"^ZOR_Basis::MTQ_Dat$", Job),
)


def register():
    collection = gdb.printing.RegexpCollectionPrettyPrinter("zor_basis")
    for name, pattern, printer in PRINTERS:
        collection.add_printer(name, pattern, printer)
    gdb.printing.register_pretty_printer(gdb.current_objfile(), collection, replace=True)


register()
