// Failing calls, and the end of a logger.

#include "tests/log/driven_logger.h"

#include <cstring>

using namespace ZOR_Basis;

namespace {

using LoggerImplFaults = DrivenLoggers;

} // namespace

TEST_F(LoggerImplFaults, loses_what_it_cannot_write_and_goes_on) {
    LoggerImpl& logger = start();
    std::string const first = lineOf(BLOCK, 'a');
    write(logger, first);
    write(logger, "tail");
    failsToOpen = true;
    tick(logger);
    tickAfter(PERIOD, logger);
    EXPECT_EQ(opened.size(), 2u);
    failsToOpen = false;
    write(logger, "later");
    tickAfter(PERIOD, logger);
    EXPECT_EQ(content(0), "later\n");
}

TEST_F(LoggerImplFaults, goes_on_where_a_file_is_in_the_way_of_its_folder) {
    makeFolder(folder());
    put(folder() + "/" + name(), "in the way");
    LoggerImpl& logger = start();
    write(logger, "line");
    tickAfter(PERIOD, logger);
    EXPECT_EQ(opened.size(), 1u);
    EXPECT_EQ(textOf(folder() + "/" + name()), "in the way");
}

TEST_F(LoggerImplFaults, goes_on_whichever_platform_call_fails) {
    for (char const* function :
         {"xos_SemMCreate", "xos_SemTake", "xos_SemGive", "xos_SemDestroy", "xos_DirCreateEx", "xos_FileSystemRoot"}) {
        for (std::uint32_t skip : {0u, 1u, 2u, 3u, 4u}) {
            SCOPED_TRACE(std::string(function) + " after " + std::to_string(skip));
            std::filesystem::remove_all(scratchRoot() / "tmp");
            xos_HostFail(function, skip, 1);
            LoggerImpl* const logger = LoggerImpl::start(name().c_str());
            write(*logger, "line");
            logger->newSession();
            write(*logger, "next");
            handClock += PERIOD;
            HQ_Basis::AlertTimer::Alert const alert{logger->alertId(), logger};
            EXPECT_EQ(xos_HostAlertFire(alert.id), 0);
            handClock += PERIOD;
            EXPECT_EQ(xos_HostAlertFire(alert.id), 0);
            if (std::strcmp(function, "xos_DirCreateEx") != 0) {
                EXPECT_EQ(content(0), "line\n");
                EXPECT_EQ(content(1), "next\n");
            }
            xos_HostFailClear();
            HQ_Basis::AlertTimer::Delete(alert.id);
            delete logger;
        }
    }
}

TEST_F(LoggerImplFaults, needs_its_alert) {
    xos_HostFail("HQ_Basis::AlertTimer::New", 0, 1);
    xos_HostCallsReset();
    EXPECT_EQ(LoggerImpl::start(name().c_str()), nullptr);
    EXPECT_EQ(xos_HostCalls("xos_SemDestroy"), xos_HostCalls("xos_SemMCreate"));
}

TEST_F(LoggerImplFaults, ends_with_its_alert_at_the_tick_after_closing_when_it_never_had_a_buffer) {
    LoggerImpl* const logger = LoggerImpl::start(name().c_str());
    std::uint32_t const id = logger->alertId();
    EXPECT_EQ(xos_HostAlertFire(id), 0);
    xos_HostCallsReset();
    logger->close();
    EXPECT_EQ(xos_HostCalls("xos_SemDestroy"), 0u) << "not before the tick";
    EXPECT_EQ(xos_HostAlertFire(id), 0);
    EXPECT_EQ(xos_HostCalls("xos_SemDestroy"), 1u);
    EXPECT_EQ(xos_HostLastCall("HQ_Basis::AlertTimer::Delete"), std::to_string(id));
    EXPECT_EQ(xos_HostAlertFire(id), -1);
    EXPECT_TRUE(opened.empty());
}

TEST_F(LoggerImplFaults, deletes_an_alert_that_outlived_it_when_it_comes_again) {
    LoggerImpl* const logger = LoggerImpl::start(name().c_str());
    std::uint32_t const id = logger->alertId();
    logger->close();
    xos_HostCallsReset();
    xos_HostFail("HQ_Basis::AlertTimer::Delete", 0, 1);
    EXPECT_EQ(xos_HostAlertFire(id), 0);
    EXPECT_EQ(xos_HostCalls("xos_SemDestroy"), 1u);
    // It may have the address of the previous logger; the old alert must not touch it.
    LoggerImpl& successor = start();
    successor.newSession();
    EXPECT_EQ(xos_HostAlertFire(id), 0);
    EXPECT_EQ(xos_HostCalls("xos_SemDestroy"), 1u);
    EXPECT_TRUE(opened.empty());
    EXPECT_EQ(xos_HostLastCall("HQ_Basis::AlertTimer::Delete"), std::to_string(id));
    EXPECT_EQ(xos_HostAlertFire(id), -1);
    tick(successor);
    EXPECT_EQ(opened.size(), 1u);
}
