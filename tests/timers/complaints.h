/// \file
/// The assertions of misused timers, as `Assertions` records them.

#ifndef TESTS_TIMERS_COMPLAINTS_H
#define TESTS_TIMERS_COMPLAINTS_H

inline constexpr char ALREADY_STARTED[] = "183 zor_basis PileTimer::start() : already started;";
inline constexpr char NOT_STARTED[] = "190 zor_basis PileTimer::start() : not started;";
inline constexpr char ALREADY_SUSPENDED[] = "197 zor_basis PileTimer::suspend() : already suspended;";
inline constexpr char NOT_SUSPENDED[] = "204 zor_basis PileTimer::resume() : not suspended;";
inline constexpr char ALREADY_REGISTERED[] = "356 zor_basis TimerMgr::add() - already registered!;";

#endif
