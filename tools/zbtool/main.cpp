// Files and trees, dictionaries, timer reports, logs and more from the command line: zbtool --help

#include "tools/zbtool/command_line.h"

int main(int count, char** arguments) { return zbtool::run(count, arguments); }
