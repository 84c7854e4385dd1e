// Nothing but the entry header before anything else: what it declares is used with the texts that it is used with.
#include <zor_basis/files.h>

#include "tests/support/scratch.h"

#include <gtest/gtest.h>

using namespace ZOR_Basis;

TEST(FilesHeader, comes_with_the_texts_that_paths_are_made_of) {
    Scratch const scratch;
    HeapStr const folder(scratch.path());
    BufStr<15> name("page ");
    name << 1;
    FPath path(folder, name);
    path.addExt(Str("tif"), true);
    WBStr wide;
    ASSERT_TRUE(Convert::Utf8ToWide(path, wide));
    EXPECT_EQ(WcPath(wide).offsetName(), path.offsetName());

    Blob const data(3, "abc");
    File file(path, File::FILE_WRITE | File::FILE_BINARY, true);
    EXPECT_TRUE(data.write(file));
    file.close();
    EXPECT_EQ(FStat::size(path), 7u);
}
