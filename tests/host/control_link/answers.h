/// \file
/// What the modules answer that are put in the place of the stand-alone ones.

#ifndef TESTS_HOST_CONTROL_LINK_ANSWERS_H
#define TESTS_HOST_CONTROL_LINK_ANSWERS_H

constexpr int OTHER_BASICS = 10;
constexpr int OTHER_URL = 20;
constexpr int OTHER_ALERTS = 40;
constexpr int ALERT_FAILED = 100;

#endif
