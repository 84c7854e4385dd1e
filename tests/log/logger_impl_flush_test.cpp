// Writing on demand.

#include "tests/log/driven_logger.h"
#include "tests/support/system_error.h"

using namespace ZOR_Basis;

namespace {

using LoggerImplFlush = DrivenLoggers;

} // namespace

TEST_F(LoggerImplFlush, writes_all_that_it_holds_when_it_is_flushed) {
    LoggerImpl& logger = start();
    EXPECT_TRUE(logger.flush());
    EXPECT_TRUE(opened.empty()) << "there is nothing to write";
    std::string const filler = lineOf(BLOCK - 10);
    write(logger, filler);
    write(logger, "goes on in the second block");
    logger.newSession();
    write(logger, "next session");
    EXPECT_TRUE(logger.flush());
    EXPECT_EQ(content(0), filler + "\ngoes on in the second block\n");
    EXPECT_EQ(content(1), "next session\n");
    write(logger, "later");
    EXPECT_TRUE(logger.flush());
    EXPECT_TRUE(logger.flush());
    EXPECT_EQ(content(1), "next session\nlater\n");
    EXPECT_EQ(opened.size(), 4u);
}

TEST_F(LoggerImplFlush, goes_on_as_ever_after_a_flush) {
    LoggerImpl& logger = start();
    write(logger, "flushed");
    logger.flush();
    write(logger, "waits");
    tick(logger);
    EXPECT_EQ(content(0), "flushed\n") << "the block is still being filled";
    tickAfter(PERIOD, logger);
    EXPECT_EQ(content(0), "flushed\nwaits\n");
}

TEST_F(LoggerImplFlush, keeps_what_it_cannot_flush) {
    LoggerImpl& logger = start();
    write(logger, "first");
    logger.newSession();
    write(logger, "second");
    failsToOpen = true;
    EXPECT_FALSE(logger.flush());
    EXPECT_EQ(opened.size(), 1u) << "stops at the first failure, so that lines keep their order";
    failsToOpen = false;
    EXPECT_TRUE(logger.flush());
    EXPECT_EQ(content(0), "first\n");
    EXPECT_EQ(content(1), "second\n");
}

TEST_F(LoggerImplFlush, leaves_the_reason_why_it_cannot_be_flushed) {
    LoggerImpl& logger = start();
    std::filesystem::create_directory(file(0));
    write(logger, "line");
    clearSystemError();
    EXPECT_FALSE(logger.flush());
    int const whenDirectory = systemError();
    std::filesystem::remove(file(0));
    std::filesystem::remove(folder() + "/" + name());
    clearSystemError();
    EXPECT_FALSE(logger.flush());
    int const whenFolderMissing = systemError();
    EXPECT_NE(whenDirectory, 0);
    EXPECT_NE(whenFolderMissing, 0);
    EXPECT_NE(whenDirectory, whenFolderMissing);
    std::filesystem::create_directory(folder() + "/" + name());
    EXPECT_TRUE(logger.flush());
    EXPECT_EQ(content(0), "line\n");
}

TEST_F(LoggerImplFlush, flushes_what_was_there_and_ends_although_lines_come_meanwhile) {
    LoggerImpl& logger = start();
    write(logger, "there");
    whileOpening = [&] { write(logger, "meanwhile"); };
    EXPECT_TRUE(logger.flush());
    whileOpening = nullptr;
    EXPECT_EQ(opened.size(), 1u);
    EXPECT_EQ(content(0), "there\n");
    EXPECT_TRUE(logger.flush());
    EXPECT_EQ(content(0), "there\nmeanwhile\n");
}
