#include "tools/zbtool/dictionary.h"

#include "tools/zbtool/byte_text.h"
#include "tools/zbtool/complaint.h"
#include "tools/zbtool/exit_code.h"
#include "tools/zbtool/json.h"
#include "tools/zbtool/utf8.h"
#include "tools/zbtool/whole_file.h"

#include <zor_basis/store/dict.h>

#include <cstdio>
#include <map>

using namespace ZOR_Basis;

namespace zbtool {
namespace {

using Dictionary = Dict<Blob, Blob>;
using Entries = std::map<std::string, std::string>;

Blob blobOf(std::string const& bytes) { return Blob(bytes.size(), bytes.data()); }

std::string_view bytesOf(Blob const& blob) { return {blob.val(), blob.size()}; }

/// A key or value as the user wrote it.
bool readBytes(DictOptions const& options, std::string const& text, std::string& bytes) {
    if (!options.hex) bytes = text;
    return !options.hex || readHex(text, bytes) || complain(text, "not pairs of hexadecimal digits");
}

/// The entries in the order of their keys, which does not change from save to save.
Entries entriesOf(Dictionary const& dict) {
    Entries entries;
    for (auto const& entry : dict) entries.emplace(bytesOf(entry.key), bytesOf(entry.value));
    return entries;
}

/// Whether a dictionary may be used; `mayBeMissing` if it is going to be saved.
bool isUsable(DictOptions const& options, Dictionary const& dict, std::string const& openFailure, bool mayBeMissing) {
    switch (dict.found()) {
    case DICT_WHOLE:
        return true;
    case DICT_MISSING:
        return mayBeMissing || complain(options.file, openFailure);
    case DICT_PART:
        return complain(options.file, "damaged, or no dictionary: only its first " + std::to_string(dict.understood()) +
                                          " bytes are whole records");
    default:
        return complain(options.file, openFailure);
    }
}

constexpr bool MAY_BE_MISSING = true;
constexpr bool MUST_EXIST = false;

/// Loads the dictionary and hands it on.
template <class Use>
int withDictionary(DictOptions const& options, bool mayBeMissing, Use use) {
    Dictionary dict;
    dict.setPath(options.file);
    std::string const openFailure = dict.read() ? "" : lastReason();
    return exitCodeOf(isUsable(options, dict, openFailure, mayBeMissing) && use(dict));
}

bool save(DictOptions const& options, Dictionary& dict) { return dict.save() || complain(options.file); }

/// A JSON object of all entries; null where one is not a text and hexadecimal digits were not asked for.
bool printJson(DictOptions const& options, Entries const& entries) {
    std::string text;
    for (auto const& [key, value] : entries) {
        if (!options.hex && (!isUtf8(key) || !isUtf8(value)))
            return complain(options.file, "key " + visibleText(key) + " or its value is not UTF-8; use --hex");
        auto const shown = [&](std::string const& bytes) { return jsonText(options.hex ? hexText(bytes) : bytes); };
        text += (text.empty() ? "\n  " : ",\n  ") + shown(key) + ": " + shown(value);
    }
    std::printf("{%s\n}\n", text.c_str());
    return true;
}

} // namespace

int dictList(DictOptions const& options) {
    return withDictionary(options, MUST_EXIST, [&](Dictionary const& dict) {
        if (options.json) return printJson(options, entriesOf(dict));
        auto const shown = [&](std::string const& bytes) { return options.hex ? hexText(bytes) : visibleText(bytes); };
        for (auto const& [key, value] : entriesOf(dict))
            std::printf("%s\t%s\n", shown(key).c_str(), shown(value).c_str());
        return true;
    });
}

int dictGet(DictOptions const& options) {
    return withDictionary(options, MUST_EXIST, [&](Dictionary const& dict) {
        std::string key;
        Blob value;
        if (!readBytes(options, options.key, key)) return false;
        if (!dict.get(blobOf(key), value)) return complain(options.file, "has no key " + options.key);
        std::string const bytes(bytesOf(value));
        std::puts((options.hex ? hexText(bytes) : visibleText(bytes)).c_str());
        return true;
    });
}

int dictSet(DictOptions const& options) {
    return withDictionary(options, MAY_BE_MISSING, [&](Dictionary& dict) {
        std::string key;
        std::string value;
        if (!readBytes(options, options.key, key) || !readBytes(options, options.value, value)) return false;
        dict.set(blobOf(key), blobOf(value));
        return save(options, dict);
    });
}

int dictRemove(DictOptions const& options) {
    return withDictionary(options, MUST_EXIST, [&](Dictionary& dict) {
        std::string key;
        Blob value;
        if (!readBytes(options, options.key, key)) return false;
        if (!dict.get(blobOf(key), value)) return complain(options.file, "has no key " + options.key);
        dict.rm(blobOf(key));
        return save(options, dict);
    });
}

int dictExport(DictOptions const& options) {
    return withDictionary(options, MUST_EXIST,
                          [&](Dictionary const& dict) { return printJson(options, entriesOf(dict)); });
}

int dictImport(DictOptions const& options) {
    return withDictionary(options, MAY_BE_MISSING, [&](Dictionary& dict) {
        std::string text;
        std::string reason;
        JsonMembers members;
        if (!readWhole(options.source, text, reason) || !readJsonTexts(text, members, reason))
            return complain(options.source == "-" ? "standard input" : options.source, reason);
        if (options.replace) dict.clean();
        for (auto const& [key, value] : members) {
            std::string keyBytes;
            std::string valueBytes;
            if (!readBytes(options, key, keyBytes) || !readBytes(options, value, valueBytes)) return false;
            dict.set(blobOf(keyBytes), blobOf(valueBytes));
        }
        return save(options, dict);
    });
}

int dictCheck(DictOptions const& options) {
    return withDictionary(options, MUST_EXIST, [&](Dictionary const& dict) {
        std::printf("%s: whole, %zu entries, %llu bytes\n", options.file.c_str(), entriesOf(dict).size(),
                    static_cast<unsigned long long>(dict.understood()));
        return true;
    });
}

} // namespace zbtool
