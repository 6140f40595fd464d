#pragma once

#include <gtest/gtest.h>

#include <functional>
#include <memory>
#include <string>

#include "platform/base/MainLoop.h"

namespace ktr::test {

/// A main loop and a way to let it run.
struct MainLoopUnderTest {
    std::shared_ptr<platform::MainLoop> loop;
    /// Runs the loop until the condition holds or `seconds` of its time have passed; false when they have.
    std::function<bool(const std::function<bool()>& condition, double seconds)> runUntil;
};

struct MainLoopCase {
    std::string name;
    std::function<MainLoopUnderTest()> make;
};

class MainLoopContract : public ::testing::TestWithParam<MainLoopCase> {
  protected:
    void SetUp() override { subject = GetParam().make(); }
    /// Runs until the condition holds; long enough for a slow machine.
    bool run(const std::function<bool()>& condition) { return subject.runUntil(condition, 20.0); }
    /// Lets a turn or a few pass.
    void runTurns() {
        for (int turn = 0; turn < 3; ++turn) {
            bool passed = false;
            subject.loop->schedule(0.002, false, [&passed] { passed = true; });
            ASSERT_TRUE(run([&passed] { return passed; }));
        }
    }
    MainLoopUnderTest subject;
};

inline std::string caseName(const ::testing::TestParamInfo<MainLoopCase>& info) {
    return info.param.name;
}

}  // namespace ktr::test
