#include "tools/zbtool/command_line.h"

#include "tools/zbtool/complaint.h"
#include "tools/zbtool/copy.h"
#include "tools/zbtool/dictionary.h"
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

#include <cstdio>

namespace zbtool {
namespace {

constexpr char ABOUT[] = "Files and trees, dictionaries, timer reports, logs and secrets, on the library zor_basis.\n"
                         "Exit codes: 0 done, 1 failed or nothing found, 2 wrong command line.";

/// A path as the system takes it on both targets: Windows finds nothing at "folder/".
std::string withoutEndSlashes(std::string path) {
    auto const isSlash = [](char c) { return c == '/' || c == '\\'; };
    while (path.size() > 1 && isSlash(path.back()) && path[path.size() - 2] != ':') path.pop_back();
    return path;
}

/// A command whose options are filled in by the parser, and which then runs with them.
template <class Options>
class Command {
public:
    Command(CLI::App& app, int& result, char const* name, char const* about, int (*run)(Options const&))
        : Command(app, result, name, about, run, std::make_shared<Options>()) {}
    /// \param shared  is filled in by several commands
    Command(CLI::App& app, int& result, char const* name, char const* about, int (*run)(Options const&),
            std::shared_ptr<Options> shared)
        : options(std::move(shared)), app_(app.add_subcommand(name, about)) {
        app_->callback([options = options, &result, run] { result = run(*options); });
    }

    Command& path(char const* name, std::string Options::*field, char const* about) {
        app_->add_option(name, (*options).*field, about)->required()->type_name("")->transform(withoutEndSlashes);
        return *this;
    }
    Command& required(char const* name, std::string Options::*field, char const* about) {
        app_->add_option(name, (*options).*field, about)->required()->type_name("");
        return *this;
    }
    Command& several(char const* name, std::vector<std::string> Options::*field, int least, char const* about) {
        constexpr int MOST = 1 << 29;
        app_->add_option(name, (*options).*field, about)
            ->required()
            ->expected(least, MOST)
            ->type_name("")
            ->transform(withoutEndSlashes);
        return *this;
    }
    template <class T>
    Command& option(char const* name, T Options::*field, char const* about) {
        app_->add_option(name, (*options).*field, about);
        return *this;
    }
    Command& flag(char const* name, bool Options::*field, char const* about) {
        app_->add_flag(name, (*options).*field, about);
        return *this;
    }

    std::shared_ptr<Options> const options;

private:
    CLI::App* const app_;
};

void addTransfers(CLI::App& app, int& result) {
    Command<CopyOptions>(app, result, "copy", "Copies files, links and whole folders.", copy)
        .several("SOURCE... TARGET", &CopyOptions::paths, 2,
                 "What to copy, and behind it a folder to copy into or the path of the copy")
        .flag("--overwrite", &CopyOptions::overwrite, "Replace existing files; otherwise they are an error");
    Command<CopyOptions>(app, result, "move", "Moves files, links and whole folders.", move)
        .several("SOURCE... TARGET", &CopyOptions::paths, 2,
                 "What to move, and behind it a folder to move into or the new path")
        .flag("--overwrite", &CopyOptions::overwrite,
              "Replace existing files and empty folders; otherwise they are an error");
    Command<RemoveOptions>(app, result, "delete", "Deletes files, links and whole folders.", remove)
        .several("PATH", &RemoveOptions::paths, 1, "What to delete")
        .flag("--yes", &RemoveOptions::yes, "Do not ask; required where there is no terminal to ask on");
}

void addTallies(CLI::App& app, int& result) {
    Command<TallyOptions>(app, result, "count", "Counts the entries of trees, their tops included.", count)
        .several("PATH", &TallyOptions::paths, 1, "A folder or a file")
        .flag("--flat", &TallyOptions::flat, "Without the folders below")
        .flag("--kinds", &TallyOptions::kinds, "Count files, folders and others apart")
        .flag("--json", &TallyOptions::json, "One JSON object for each path");
    Command<TallyOptions>(app, result, "size", "Adds up the sizes of the files in trees, in bytes.", size)
        .several("PATH", &TallyOptions::paths, 1, "A folder or a file")
        .flag("--flat", &TallyOptions::flat, "Without the folders below")
        .flag("--json", &TallyOptions::json, "One JSON object for each path");
}

void addFind(CLI::App& app, int& result) {
    Command<FindOptions>(app, result, "find", "Prints the paths below a folder that match.", find)
        .path("FOLDER", &FindOptions::folder, "Where to search")
        .option("WILDCARD", &FindOptions::wildcard, "What names match: * any characters, ? any single one")
        .flag("--any-case", &FindOptions::anyCase, "The wildcard ignores case")
        .option("--name", &FindOptions::name, "Only entries of this name, in any case")
        .option("--ext", &FindOptions::extension, "Only names with this extension, in any case")
        .flag("--files", &FindOptions::files, "Only files, links and the like")
        .flag("--folders", &FindOptions::folders, "Only folders")
        .flag("--first", &FindOptions::first, "Stop at the first match")
        .flag("--flat", &FindOptions::flat, "Without the folders below");
}

void addDict(CLI::App& app, int& result) {
    CLI::App* const dict = app.add_subcommand("dict", "Reads and changes a dictionary file.")->require_subcommand(1);
    auto const options = std::make_shared<DictOptions>();
    dict->add_option("FILE", options->file, "The dictionary's file")->required()->type_name("");
    auto const add = [&](char const* name, char const* about, int (*run)(DictOptions const&)) {
        return Command<DictOptions>(*dict, result, name, about, run, options)
            .flag("--hex", &DictOptions::hex, "Keys and values are pairs of hexadecimal digits");
    };
    add("list", "Prints all entries, sorted by key.", dictList).flag("--json", &DictOptions::json, "As a JSON object");
    add("get", "Prints the value of a key.", dictGet).required("KEY", &DictOptions::key, "The key");
    add("set", "Stores a value, in a new file if there is none.", dictSet)
        .required("KEY", &DictOptions::key, "The key")
        .required("VALUE", &DictOptions::value, "Its value");
    add("rm", "Removes a key.", dictRemove).required("KEY", &DictOptions::key, "The key");
    add("export", "Prints a JSON object that import reads.", dictExport);
    add("import", "Stores the members of a JSON object.", dictImport)
        .option("SOURCE", &DictOptions::source, "A file; - or none: standard input")
        .flag("--replace", &DictOptions::replace, "Remove all other entries");
    add("check", "Tells whether the file is whole.", dictCheck);
}

void addTimers(CLI::App& app, int& result) {
    Command<TimersOptions>(app, result, "timers", "Prints timer reports as one table; durations in microseconds.",
                           timers)
        .several("REPORT", &TimersOptions::reports, 1, "A file SECONDS_MANAGER_RIP.timer; several are added up")
        .flag("--compare", &TimersOptions::compare, "Show the averages of the reports beside each other")
        .option("--sort", &TimersOptions::sortBy, "The column to sort by; total, or the change, if none is given")
        .flag("--reverse", &TimersOptions::reverse, "Numbers from the smallest, names from the last")
        .flag("--json", &TimersOptions::json, "As a JSON array")
        .flag("--csv", &TimersOptions::csv, "As comma-separated values")
        .option("--html", &TimersOptions::html, "Write a page to this file instead, and print its path")
        .flag("--overwrite", &TimersOptions::overwrite, "Replace an existing page; otherwise it is an error");
}

void addLog(CLI::App& app, int& result) {
    Command<LogOptions>(app, result, "log", "Prints the lines of a log.", printLog)
        .required("NAME", &LogOptions::name, "The log's name")
        .option("--root", &LogOptions::root, "The root folder; XOS_ROOT or the current folder if none is given")
        .option("--session", &LogOptions::session, "Only the file of this session, from 0")
        .flag("--follow", &LogOptions::follow, "Also print the lines that come, until Ctrl-C");
}

void addCrypt(CLI::App& app, int& result) {
    CLI::App* const crypt =
        app.add_subcommand("crypt", "Encrypts and decrypts files as the library does (MD5 and RC2).")
            ->require_subcommand(1);
    auto const options = std::make_shared<CryptOptions>();
    auto const add = [&](char const* name, char const* about, int (*run)(CryptOptions const&)) {
        Command<CryptOptions>(*crypt, result, name, about, run, options)
            .required("SOURCE", &CryptOptions::source, "The file to read")
            .required("TARGET", &CryptOptions::target, "The file to write")
            .option("--secret-file", &CryptOptions::secretFile,
                    "The file that contains the secret; the terminal is asked if none is given")
            .flag("--overwrite", &CryptOptions::overwrite, "Replace an existing target; otherwise it is an error");
    };
    add("encrypt", "Encrypts a file.", encrypt);
    add("decrypt", "Decrypts a file.", decrypt);
}

void addSystem(CLI::App& app, int& result) {
    Command<MachineOptions>(app, result, "sys", "Prints what the library's queries tell about this machine.",
                            describeMachine)
        .flag("--json", &MachineOptions::json, "As a JSON object");
    CLI::App* const url = app.add_subcommand("url", "Works with URLs.")->require_subcommand(1);
    Command<FetchOptions>(*url, result, "get", "Fetches what a URL names into a file.", fetch)
        .required("URL", &FetchOptions::url, "http, https or file")
        .required("TARGET", &FetchOptions::target, "The file to write")
        .option("--user", &FetchOptions::user, "The user name that the server asks for")
        .option("--password-file", &FetchOptions::passwordFile, "The file that contains the password")
        .flag("--overwrite", &FetchOptions::overwrite, "Replace an existing target; otherwise it is an error");
}

/// The parser's messages in one line.
std::string oneLine(std::string text) {
    while (!text.empty() && text.back() == '\n') text.pop_back();
    for (char& c : text) {
        if (c == '\n') c = ' ';
    }
    return text;
}

int misused(std::string const& what, std::string const& reason) {
    complain(what, reason + "; see zbtool --help");
    return MISUSED;
}

} // namespace

int run(int count, char** arguments) {
    CLI::App app(ABOUT, "zbtool");
    int result = DONE;
    useBinaryStreams();
    addTransfers(app, result);
    addTallies(app, result);
    addFind(app, result);
    addDict(app, result);
    addTimers(app, result);
    addLog(app, result);
    addCrypt(app, result);
    addSystem(app, result);
    if (count < 2) return misused("command", "is missing");
    auto const isNamed = [&](CLI::App const* command) { return command->check_name(arguments[1]); };
    if (arguments[1][0] != '-' && app.get_subcommands(isNamed).empty()) return misused(arguments[1], "no such command");
    try {
        app.parse(count, arguments);
    } catch (CLI::ParseError const& error) {
        if (error.get_exit_code() == 0) return app.exit(error);
        return misused(arguments[1], oneLine(error.what()));
    }
    if (std::fflush(stdout) == 0 && std::ferror(stdout) == 0) return result;
    return exitCodeOf(complain("standard output"));
}

} // namespace zbtool
