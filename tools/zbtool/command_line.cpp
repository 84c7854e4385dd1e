#include "tools/zbtool/command_line.h"

#include "tools/zbtool/complaint.h"
#include "tools/zbtool/copy.h"
#include "tools/zbtool/dictionary.h"
#include "tools/zbtool/entry_names.h"
#include "tools/zbtool/exit_code.h"
#include "tools/zbtool/fetch.h"
#include "tools/zbtool/find.h"
#include "tools/zbtool/log_files.h"
#include "tools/zbtool/machine.h"
#include "tools/zbtool/move.h"
#include "tools/zbtool/remove.h"
#include "tools/zbtool/secrets.h"
#include "tools/zbtool/tally.h"
#include "tools/zbtool/terminal.h"
#include "tools/zbtool/timers.h"

#include <CLI/CLI.hpp>

#include <charconv>
#include <cstdio>

namespace zbtool {
namespace {

constexpr char ABOUT[] = "Files and trees, dictionaries, timer reports, logs and secrets, on the library zor_basis.\n"
                         "Exit codes: 0 done, 1 failed or nothing found, 2 wrong command line.";

using Words = CLI::results_t;

std::string whyEmpty(std::string const& word) { return word.empty() ? "must not be empty" : ""; }

std::string whyNoPath(std::string const& path) {
    return path.empty() ? whyEmpty(path) : std::string(whyUnreachable(path));
}

/// A command whose options are filled in by the parser, and which then runs with them. The parser gets functions that
/// store words rather than the fields: for each type of field it would bring templates that take long to compile.
class Command {
public:
    /// \param options  must outlive the parser, and may be filled in by several commands
    template <class Options>
    Command(CLI::App& app, int& result, char const* name, char const* about, int (*run)(Options const&),
            Options const& options)
        : app_(app.add_subcommand(name, about)) {
        app_->callback([&options, &result, run] { result = run(options); });
    }

    Command& folder(char const* name, std::string& field, char const* about) {
        addTo(*app_, name, field, about)->required()->type_name("")->check(whyNoPath)->transform(withoutEndSlashes);
        return *this;
    }
    Command& file(char const* name, std::string& field, char const* about) {
        addTo(*app_, name, field, about)->required()->type_name("")->check(whyNoPath);
        return *this;
    }
    Command& word(char const* name, std::string& field, char const* about) {
        addTo(*app_, name, field, about)->required()->type_name("")->check(whyEmpty);
        return *this;
    }
    /// A text that may be empty.
    Command& text(char const* name, std::string& field, char const* about) {
        addTo(*app_, name, field, about)->required()->type_name("");
        return *this;
    }
    Command& paths(char const* name, std::vector<std::string>& field, int least, char const* about) {
        constexpr int MOST = 1 << 29;
        auto const take = [&field](Words const& words) {
            for (std::string const& word : words) field.push_back(withoutEndSlashes(word));
            return true;
        };
        app_->add_option(name, take, about)
            ->required()
            ->expected(least, MOST)
            ->allow_extra_args()
            ->type_name("")
            ->check(whyNoPath);
        return *this;
    }
    Command& option(char const* name, std::string& field, char const* about) {
        last_ = addTo(*app_, name, field, about)->check(whyEmpty);
        return *this;
    }
    Command& pathOption(char const* name, std::string& field, char const* about) {
        last_ = addTo(*app_, name, field, about)->check(whyNoPath);
        return *this;
    }
    Command& number(char const* name, int& field, char const* about) {
        auto const take = [&field](Words const& words) {
            std::string const& word = words.back();
            auto const [end, error] = std::from_chars(word.data(), word.data() + word.size(), field);
            return error == std::errc() && end == word.data() + word.size() && field >= 0;
        };
        last_ = app_->add_option(name, take, about)->type_name("NUMBER");
        return *this;
    }
    Command& flag(char const* name, bool& field, char const* about) {
        last_ = app_->add_flag_callback(
            name, [&field] { field = true; }, about);
        return *this;
    }
    /// The last option makes sense with another one only.
    Command& needing(char const* other) {
        last_->needs(app_->get_option(other));
        return *this;
    }
    /// The last option makes no sense with others.
    Command& without(std::initializer_list<char const*> others) {
        for (char const* other : others) last_->excludes(app_->get_option(other));
        return *this;
    }

    static CLI::Option* addTo(CLI::App& app, char const* name, std::string& field, char const* about) {
        auto const take = [&field](Words const& words) {
            field = words.back();
            return true;
        };
        return app.add_option(name, take, about)->type_name("TEXT");
    }

private:
    CLI::App* const app_;
    CLI::Option* last_ = nullptr;
};

/// The options of all commands, of which one runs.
struct Options {
    CopyOptions copy;
    RemoveOptions remove;
    TallyOptions tally;
    FindOptions find;
    DictOptions dict;
    TimersOptions timers;
    LogOptions log;
    CryptOptions crypt;
    MachineOptions machine;
    FetchOptions fetch;
};

void addTransfers(CLI::App& app, Options& all, int& result) {
    Command(app, result, "copy", "Copies files, links and whole folders.", copy, all.copy)
        .paths("SOURCE... TARGET", all.copy.paths, 2,
               "What to copy, and behind it a folder to copy into or the path of the copy")
        .flag("--overwrite", all.copy.overwrite, "Replace existing files; otherwise they are an error");
    Command(app, result, "move", "Moves files, links and whole folders.", move, all.copy)
        .paths("SOURCE... TARGET", all.copy.paths, 2,
               "What to move, and behind it a folder to move into or the new path")
        .flag("--overwrite", all.copy.overwrite,
              "Replace existing files and empty folders; otherwise they are an error");
    Command(app, result, "delete", "Deletes files, links and whole folders.", remove, all.remove)
        .paths("PATH", all.remove.paths, 1, "What to delete")
        .flag("--yes", all.remove.yes, "Do not ask; required where there is no terminal to ask on");
}

void addTallies(CLI::App& app, Options& all, int& result) {
    Command(app, result, "count", "Counts the entries of trees, their tops included.", count, all.tally)
        .paths("PATH", all.tally.paths, 1, "A folder or a file")
        .flag("--flat", all.tally.flat, "Without the folders below")
        .flag("--kinds", all.tally.kinds, "Count files, folders and others apart")
        .flag("--json", all.tally.json, "One JSON object for each path");
    Command(app, result, "size", "Adds up the sizes of the files in trees, in bytes.", size, all.tally)
        .paths("PATH", all.tally.paths, 1, "A folder or a file")
        .flag("--flat", all.tally.flat, "Without the folders below")
        .flag("--json", all.tally.json, "One JSON object for each path");
}

void addFind(CLI::App& app, Options& all, int& result) {
    Command(app, result, "find", "Prints the paths below a folder that match.", find, all.find)
        .folder("FOLDER", all.find.folder, "Where to search")
        .option("WILDCARD", all.find.wildcard, "What names match: * any characters, ? any single one")
        .flag("--any-case", all.find.anyCase, "The wildcard ignores case")
        .needing("WILDCARD")
        .option("--name", all.find.name, "Only entries of this name, in any case")
        .option("--ext", all.find.extension, "Only names with this extension, in any case")
        .flag("--files", all.find.files, "Only files, links and the like")
        .flag("--folders", all.find.folders, "Only folders")
        .without({"--files"})
        .flag("--first", all.find.first, "Stop at the first match")
        .flag("--flat", all.find.flat, "Without the folders below");
}

void addDict(CLI::App& app, Options& all, int& result) {
    CLI::App* const dict = app.add_subcommand("dict", "Reads and changes a dictionary file.")->require_subcommand(1);
    Command::addTo(*dict, "FILE", all.dict.file, "The dictionary's file")->required()->type_name("")->check(whyNoPath);
    constexpr char HEX[] = "Keys and values are pairs of hexadecimal digits";
    Command(*dict, result, "list", "Prints all entries, sorted by key.", dictList, all.dict)
        .flag("--hex", all.dict.hex, HEX)
        .flag("--json", all.dict.json, "As a JSON object");
    Command(*dict, result, "get", "Prints the value of a key.", dictGet, all.dict)
        .flag("--hex", all.dict.hex, HEX)
        .text("KEY", all.dict.key, "The key");
    Command(*dict, result, "set", "Stores a value, in a new file if there is none.", dictSet, all.dict)
        .flag("--hex", all.dict.hex, HEX)
        .text("KEY", all.dict.key, "The key")
        .text("VALUE", all.dict.value, "Its value");
    Command(*dict, result, "rm", "Removes a key.", dictRemove, all.dict)
        .flag("--hex", all.dict.hex, HEX)
        .text("KEY", all.dict.key, "The key");
    Command(*dict, result, "export", "Prints a JSON object that import reads.", dictExport, all.dict)
        .flag("--hex", all.dict.hex, HEX);
    Command(*dict, result, "import", "Stores the members of a JSON object.", dictImport, all.dict)
        .flag("--hex", all.dict.hex, HEX)
        .pathOption("SOURCE", all.dict.source, "A file; - or none: standard input")
        .flag("--replace", all.dict.replace, "Remove all other entries");
    Command(*dict, result, "check", "Tells whether the file is whole.", dictCheck, all.dict);
}

void addTimers(CLI::App& app, Options& all, int& result) {
    Command(app, result, "timers", "Prints timer reports as one table; durations in microseconds.", timers, all.timers)
        .paths("REPORT", all.timers.reports, 1, "A file SECONDS_MANAGER_RIP.timer; several are added up")
        .flag("--compare", all.timers.compare, "Show the averages of the reports beside each other")
        .option("--sort", all.timers.sortBy, "The column to sort by; total, or the change, if none is given")
        .flag("--reverse", all.timers.reverse, "Numbers from the smallest, names from the last")
        .flag("--json", all.timers.json, "As a JSON array")
        .flag("--csv", all.timers.csv, "As comma-separated values")
        .without({"--json"})
        .pathOption("--html", all.timers.html, "Write a page to this file instead, and print its path")
        .without({"--json", "--csv"})
        .flag("--overwrite", all.timers.overwrite, "Replace an existing page; otherwise it is an error")
        .needing("--html");
}

void addLog(CLI::App& app, Options& all, int& result) {
    Command(app, result, "log", "Prints the lines of a log.", printLog, all.log)
        .word("NAME", all.log.name, "The log's name")
        .pathOption("--root", all.log.root, "The root folder; XOS_ROOT or the current folder if none is given")
        .number("--session", all.log.session, "Only the file of this session, from 0")
        .flag("--follow", all.log.follow, "Also print the lines that come, until Ctrl-C");
}

void addCrypt(CLI::App& app, Options& all, int& result) {
    CLI::App* const crypt =
        app.add_subcommand("crypt", "Encrypts and decrypts files as the library does (MD5 and RC2).")
            ->require_subcommand(1);
    auto const add = [&](char const* name, char const* about, int (*run)(CryptOptions const&)) {
        Command(*crypt, result, name, about, run, all.crypt)
            .file("SOURCE", all.crypt.source, "The file to read")
            .file("TARGET", all.crypt.target, "The file to write")
            .pathOption("--secret-file", all.crypt.secretFile,
                        "The file that contains the secret; the terminal is asked if none is given")
            .flag("--overwrite", all.crypt.overwrite, "Replace an existing target; otherwise it is an error");
    };
    add("encrypt", "Encrypts a file.", encrypt);
    add("decrypt", "Decrypts a file.", decrypt);
}

void addSystem(CLI::App& app, Options& all, int& result) {
    Command(app, result, "sys", "Prints what the library's queries tell about this machine.", describeMachine,
            all.machine)
        .flag("--json", all.machine.json, "As a JSON object");
    CLI::App* const url = app.add_subcommand("url", "Works with URLs.")->require_subcommand(1);
    Command(*url, result, "get", "Fetches what a URL names into a file.", fetch, all.fetch)
        .word("URL", all.fetch.url, "http, https or file")
        .file("TARGET", all.fetch.target, "The file to write")
        .option("--user", all.fetch.user, "The user name that the server asks for")
        .pathOption("--password-file", all.fetch.passwordFile, "The file that contains the password")
        .needing("--user")
        .flag("--overwrite", all.fetch.overwrite, "Replace an existing target; otherwise it is an error");
}

/// The parser's messages in one line.
std::string oneLine(std::string text) {
    while (!text.empty() && text.back() == '\n') text.pop_back();
    for (char& c : text) {
        if (c == '\n') c = ' ';
    }
    return text;
}

/// The words of the command that the arguments name, as far as they were understood, each behind the arguments that
/// come before it on a command line.
std::string commandOf(CLI::App const& app, bool withArguments) {
    std::string words;
    for (CLI::App const* command = &app; !command->get_subcommands().empty();) {
        bool const isDict = withArguments && words == " dict";
        command = command->get_subcommands().front();
        words += (isDict ? " FILE " : " ") + command->get_name();
    }
    return words;
}

int misused(CLI::App const& app, std::string const& reason) {
    std::string const command = commandOf(app, false);
    complain(command.empty() ? "command" : command.substr(1),
             reason + "; see zbtool" + commandOf(app, true) + " --help");
    return MISUSED;
}

} // namespace

int run(int count, char** arguments) {
    Options all;
    CLI::App app(ABOUT, "zbtool");
    int result = DONE;
    useBinaryStreams();
    app.set_version_flag("--version", "zbtool " ZBTOOL_VERSION, "Print the version and exit");
    for (auto* const add : {addTransfers, addTallies, addFind, addDict, addTimers, addLog, addCrypt, addSystem})
        add(app, all, result);
    if (count < 2) return misused(app, "is missing");
    auto const isNamed = [&](CLI::App const* command) { return command->check_name(arguments[1]); };
    if (arguments[1][0] != '-' && app.get_subcommands(isNamed).empty())
        return misused(app, std::string(arguments[1]) + " does not exist");
    try {
        app.parse(count, arguments);
    } catch (CLI::ParseError const& error) {
        if (error.get_exit_code() == 0) return app.exit(error);
        return misused(app, oneLine(error.what()));
    }
    if (std::fflush(stdout) == 0 && std::ferror(stdout) == 0) return result;
    return exitCodeOf(complain("standard output"));
}

} // namespace zbtool
