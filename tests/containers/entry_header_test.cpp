// The room's header is the only one included: it also declares the texts and bytes that containers hold.
#include <zor_basis/containers.h>

#include <gtest/gtest.h>

using namespace ZOR_Basis;

TEST(ContainersHeader, comes_with_the_texts_and_bytes_that_are_held) {
    Dict<Blob, Blob> dict;
    SecretBlob secret;
    secret.add(3, "abc");
    dict.set(Blob(3, "key"), secret);
    Blob value;
    EXPECT_TRUE(dict.get(Blob(3, "key"), value));
    EXPECT_TRUE(value == secret);
    BufStr<15> const name("name");
    EXPECT_TRUE(HashedStr<HeapStr>(name) == HashedStr<HeapStr>(FPath("name")));
    EXPECT_EQ(WBStr(ZB_W("wide")).size(), 4u);
}
