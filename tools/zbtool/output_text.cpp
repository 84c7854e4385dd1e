#include "tools/zbtool/output_text.h"

#include "tools/zbtool/byte_text.h"
#include "tools/zbtool/terminal.h"

namespace zbtool {

std::string shownName(std::string_view name) { return outputIsTerminal() ? harmlessText(name) : std::string(name); }

std::string shownLines(std::string_view lines) {
    return outputIsTerminal() ? harmlessLines(lines) : std::string(lines);
}

} // namespace zbtool
