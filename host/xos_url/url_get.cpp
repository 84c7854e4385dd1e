#include "basis/platform/xos_url.h"

#include "host/control_link/control_link.h"
#include "host/xos_url/fetch.h"
#include "host/xos_url/reason.h"
#include "host/xos_url/target_file.h"
#include "host/xos_url/url_files.h"
#include "host/xos_url/url_text.h"

#include <memory>
#include <new>

namespace host {

namespace {

constexpr std::uint32_t CONNECT_SECONDS = 30;
constexpr std::uint32_t STALL_SECONDS = 60;

class FileSink : public BodySink {
public:
    explicit FileSink(TargetFile& file) : file_(file) {}
    bool take(void const* data, std::size_t size) override { return file_.write(data, size); }

private:
    TargetFile& file_;
};

bool copyBytes(std::FILE* from, TargetFile& to) {
    char piece[65536];
    std::size_t count = 0;
    while ((count = std::fread(piece, 1, sizeof piece, from)) != 0) {
        if (!to.write(piece, count)) return false;
    }
    return std::ferror(from) == 0;
}

struct Close {
    void operator()(std::FILE* file) const {
        KeepReason const keep;
        std::fclose(file);
    }
};

/// Closed when it returns: the source may be the target itself.
bool readFile(FileUrl const& url, TargetFile& target) {
    std::unique_ptr<std::FILE, Close> const source{openRegularFile(pathOfFileUrl(url))};
    return source != nullptr && target.open() && copyBytes(source.get(), target);
}

bool getFile(char const* url, TargetFile& target) {
    std::optional<FileUrl> const parsed = parseFileUrl(url);
    if (!parsed.has_value()) return failFor(Reason::BAD_ARGUMENT);
    return readFile(*parsed, target) && target.commit();
}

bool getOverHttp(FetchRequest const& request, TargetFile& target) {
    FileSink sink{target};
    return target.open() && fetch(request, sink) && target.commit();
}

bool get(char const* url, char const* targetPath, char const* user, char const* password) {
    TargetFile target{systemPath(targetPath)};
    switch (schemeOf(url)) {
    case Scheme::FILE:
        return getFile(url, target);
    case Scheme::HTTP:
    case Scheme::HTTPS:
        return getOverHttp({escapedUrl(url), user, password, CONNECT_SECONDS, STALL_SECONDS}, target);
    default:
        return failFor(Reason::UNKNOWN_SCHEME);
    }
}

} // namespace

} // namespace host

extern "C" int xos_URLGet(char const* url, char const* target, char const* first, char const* second) {
    using host::addressArgument;
    constexpr int FAILED = -1;
    auto const get = [=] {
        if (url == nullptr || target == nullptr || *target == '\0') return host::failFor(host::Reason::BAD_ARGUMENT);
        try {
            return host::get(url, target, first, second);
        } catch (std::bad_alloc const&) { return host::failFor(host::Reason::NO_MEMORY); }
    };
    host::Arguments const arguments{addressArgument(url), addressArgument(target), addressArgument(first),
                                    addressArgument(second)};
    return host::call("xos_URLGet", arguments, FAILED, [&] { return get() ? 0 : FAILED; });
}
