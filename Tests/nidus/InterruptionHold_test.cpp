#include "nidus/InterruptionHold.h"

#include <gtest/gtest.h>

#include <iostream>
#include <optional>

namespace nidus {
namespace {

using ::testing::ExitedWithCode;
using ::testing::KilledBySignal;

/// Lets the signals do what they do by default, whatever the one who started the tests ignores.
void heedSignals() {
  for (const int signal : {SIGINT, SIGTERM, SIGHUP}) std::signal(signal, SIG_DFL);
}

void say(const char* text) { std::cerr << text << std::flush; }

TEST(InterruptionHoldTest, LetsTheWorkEndFirst) {
  for (const int signal : {SIGINT, SIGTERM, SIGHUP}) {
    EXPECT_EXIT(
        {
          heedSignals();
          const InterruptionHold hold;
          std::raise(signal);
          say("done");
        },
        KilledBySignal(signal), "done");
  }
}

TEST(InterruptionHoldTest, YieldsToASecondInterruption) {
  EXPECT_EXIT(
      {
        heedSignals();
        const InterruptionHold hold;
        std::raise(SIGINT);
        say("once");
        std::raise(SIGINT);
        say("twice");
      },
      KilledBySignal(SIGINT), "once$");
}

TEST(InterruptionHoldTest, LetsTheOuterHoldEndFirst) {
  EXPECT_EXIT(
      {
        heedSignals();
        const InterruptionHold outer;
        {
          const InterruptionHold inner;
          std::raise(SIGINT);
          say("inner ");
        }
        say("outer");
      },
      KilledBySignal(SIGINT), "inner outer");
}

TEST(InterruptionHoldTest, HoldsNothingAfterItsEnd) {
  EXPECT_EXIT(
      {
        heedSignals();
        std::optional<InterruptionHold> hold(std::in_place);
        hold.reset();
        say("released");
        std::raise(SIGINT);
        say("on");
      },
      KilledBySignal(SIGINT), "released$");
}

TEST(InterruptionHoldTest, LeavesIgnoredSignalsIgnored) {
  EXPECT_EXIT(
      {
        std::signal(SIGHUP, SIG_IGN);
        std::optional<InterruptionHold> hold(std::in_place);
        std::raise(SIGHUP);
        hold.reset();
        std::raise(SIGHUP);
        std::_Exit(7);
      },
      ExitedWithCode(7), "");
}

}  // namespace
}  // namespace nidus
