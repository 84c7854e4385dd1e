/// \file
/// Loggers whose alert, clock and files the test controls.

#ifndef TESTS_LOG_DRIVEN_LOGGER_H
#define TESTS_LOG_DRIVEN_LOGGER_H

#include "basis/files/system_calls.h"
#include "basis/log/logger_impl.h"
#include "tests/log/hand_clock.h"
#include "tests/support/scratch.h"
#include "tests/support/scratch_root.h"

#include <xos_host.h>

#include <gtest/gtest.h>

#include <functional>
#include <mutex>
#include <string>
#include <vector>

/// Each test has a log of its own name. Loggers are never closed here, because the thread of a closed one never ends.
class DrivenLoggers : public testing::Test {
protected:
    static constexpr std::uint32_t PERIOD = ZOR_Basis::LoggerImpl::PERIOD_MS;
    static constexpr std::size_t BLOCK = ZOR_Basis::LoggerImpl::BLOCK_SIZE;

    DrivenLoggers() {
        handClock = 1'000'000;
        current_ = this;
        ZOR_Basis::systemCalls.openStream = open;
    }
    ~DrivenLoggers() override {
        xos_HostFailClear();
        ZOR_Basis::systemCalls.openStream = realOpen_;
        current_ = nullptr;
        for (ZOR_Basis::LoggerImpl* logger : loggers_) {
            HQ_Basis::AlertTimer::Delete(logger->alertId());
            delete logger;
        }
    }

    static std::string name() { return testing::UnitTest::GetInstance()->current_test_info()->name(); }
    static std::string folder() { return (scratchRoot() / "tmp/zb_log").generic_string(); }
    static std::string file(int session) { return folder() + "/" + name() + "/" + std::to_string(session) + ".log"; }
    /// The content of a file, with "\n" as line end.
    static std::string content(int session) {
        std::string lines;
        for (char c : textOf(file(session))) {
            if (c != '\r') lines += c;
        }
        return lines;
    }

    ZOR_Basis::LoggerImpl& start(std::string const& of) {
        loggers_.push_back(ZOR_Basis::LoggerImpl::start(of.c_str()));
        return *loggers_.back();
    }
    ZOR_Basis::LoggerImpl& start() { return start(name()); }

    /// \param sizeWithEnd  counts the line end, too
    static std::string lineOf(std::size_t sizeWithEnd, char c = 'x') { return std::string(sizeWithEnd - 1, c); }

    static void write(ZOR_Basis::Logger& logger, std::string line) {
        line.append(2, '\0');
        logger.out(line.data());
    }
    /// Fires the logger's alert.
    static void tick(ZOR_Basis::LoggerImpl const& logger) { ASSERT_EQ(xos_HostAlertFire(logger.alertId()), 0); }
    static void tickAfter(std::uint32_t ms, ZOR_Basis::LoggerImpl const& logger) {
        handClock += ms;
        tick(logger);
    }

    /// The files opened since the start of the test, with their modes.
    std::vector<std::string> opened;
    /// Called at each opening, while the logger is not locked.
    std::function<void()> whileOpening;
    bool failsToOpen = false;

private:
    static std::FILE* open(char const* path, char const* mode) {
        {
            std::lock_guard const held(current_->openedMutex_);
            current_->opened.push_back(std::string(mode) + " " + path);
        }
        if (current_->whileOpening) current_->whileOpening();
        return current_->failsToOpen ? nullptr : current_->realOpen_(path, mode);
    }

    static inline DrivenLoggers* current_ = nullptr;
    decltype(ZOR_Basis::systemCalls.openStream) const realOpen_ = ZOR_Basis::systemCalls.openStream;
    std::vector<ZOR_Basis::LoggerImpl*> loggers_;
    std::mutex openedMutex_;
};

#endif
