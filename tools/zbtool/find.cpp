#include "tools/zbtool/find.h"

#include "tools/zbtool/choices.h"
#include "tools/zbtool/complaint.h"
#include "tools/zbtool/exit_code.h"
#include "tools/zbtool/interruption.h"
#include "tools/zbtool/output_text.h"
#include "tools/zbtool/progress.h"
#include "tools/zbtool/tree_work.h"

#include <algorithm>
#include <cstdio>

using namespace ZOR_Basis;

namespace zbtool {
namespace {

std::string upper(std::string text) {
    std::transform(text.begin(), text.end(), text.begin(),
                   [](unsigned char c) { return static_cast<char>(std::toupper(c)); });
    return text;
}

class Search {
public:
    explicit Search(FindOptions const& options) : options_(options) {
        if (options_.anyCase) options_.wildcard = upper(options_.wildcard);
        options_.name = upper(options_.name);
        options_.extension = upper(options_.extension);
        if (!options_.extension.empty() && options_.extension[0] != '.')
            options_.extension = std::string(".").append(options_.extension);
    }

    bool matches(std::string const& name, FStat const& status) const {
        if (options_.files != options_.folders && options_.folders != status.isDir()) return false;
        std::string const any = upper(name);
        if (!options_.name.empty() && any != options_.name) return false;
        if (!options_.extension.empty() && !any.ends_with(options_.extension)) return false;
        std::string const& compared = options_.anyCase ? any : name;
        return options_.wildcard.empty() || FPath::matchWildCard(options_.wildcard.c_str(), compared.c_str());
    }

private:
    FindOptions options_;
};

} // namespace

int find(FindOptions const& options) {
    if (!FStat(options.folder.c_str(), SYSTEM_ONLY).exist()) return exitCodeOf(complain(options.folder));
    Search const search(options);
    Progress progress("searching");
    std::uint64_t found = 0;
    bool good = true;
    auto const searchFolder = [&](FPath const& folder, TreeWork::Folders& below) {
        bool const read = forEachEntry(folder, [&](FPath const& path, FStat const& status) {
            progress.add({1, status.size()});
            if (status.isDir() && !options.flat) below.push_back(path);
            if (!search.matches(path.c_str() + path.offsetName(), status)) return true;
            Progress::hide();
            std::puts(shownName(path.c_str()).c_str());
            ++found;
            return !options.first;
        });
        good &= read;
        return !options.first || found == 0;
    };
    TreeWork(searchFolder, 1).run(options.folder);
    return exitCodeOf(good && found > 0);
}

} // namespace zbtool
