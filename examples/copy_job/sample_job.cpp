#include "examples/copy_job/sample_job.h"

#include "examples/copy_job/choices.h"

#include <cstdio>
#include <random>

using namespace ZOR_Basis;

namespace {

constexpr int PAGES = 40;

bool write(FPath const& path, Str const& text) {
    File file(path, File::FILE_WRITE | File::FILE_TRUNC | File::FILE_BINARY);
    return file.isOpen() && file->write(text.c_str(), text.size()) == text.size();
}

bool writeTicket(FPath const& folder) {
    BufStr<255> text("job: sample\ncopies: 2\nmedia: A4\n");
    text << "pages: " << PAGES << "\n";
    return write(FPath(folder, "job.ticket"), text);
}

bool writePages(FPath const& folder) {
    BufStr<255> text;
    for (int page = 1; page <= PAGES; ++page) {
        char name[32];
        std::snprintf(name, sizeof name, "page-%04d.pdl", page);
        text.clear();
        for (int line = 1; line <= 20 * page; ++line) text << "page " << page << ", line " << line << "\n";
        if (!write(FPath(folder, name), text)) return false;
    }
    return true;
}

/// A file of bytes that do not compress, as images and fonts are.
bool writeBinary(FPath const& path, std::uint64_t size, std::mt19937& source) {
    BufStr<255> bytes;
    bytes.extendBuf(size);
    for (std::uint64_t i = 0; i < size; ++i)
        bytes.getBuf()[i] = static_cast<char>(source() | 1); // no zero ends the text
    bytes.resize(size);
    return write(path, bytes);
}

bool writeResources(FPath const& folder) {
    std::mt19937 source(7);
    for (char const* kind : {"fonts", "images"}) {
        FPath const place(folder, kind);
        if (!Dir::New(place, WITHOUT_PARENTS)) return false;
        for (int i = 1; i <= 8; ++i) {
            BufStr<15> name(kind, 4);
            name << "-" << i << ".bin";
            if (!writeBinary(FPath(place, name), 40'000u * static_cast<unsigned>(i), source)) return false;
        }
    }
    return true;
}

} // namespace

bool makeSampleJob(FPath const& folder) {
    FPath const pages(folder, "pages");
    FPath const resources(folder, "resources");
    return Dir::New(pages, WITH_PARENTS) && Dir::New(resources, WITH_PARENTS) && writeTicket(folder) &&
           writePages(pages) && writeResources(resources);
}
