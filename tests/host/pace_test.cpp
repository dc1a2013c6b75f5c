#include "host/pace.h"

#include <gtest/gtest.h>

#include <cmath>

using namespace tidemark;

namespace {

struct Paced {
    Pace pace;
    double now = 0.0;
    int changes = 0;

    Paced() { pace.allowResolution(true); }

    // Simulates a display with 1 / period frames a second and frames that need `needed` seconds at the best level, less
    // at others.
    void run(double seconds, double needed, double period = 1.0 / 60, bool hasInk = false) {
        for (const double end = now + seconds; now < end;) {
            const auto [mesh, resolution, inkSteps] = pace.level();
            const double work = needed * (0.3 + 0.2 * mesh + 0.5 * resolution * resolution);
            now += period * std::ceil(work / period - 1e-6);
            changes += pace.frameDrawn(now, 0.0, hasInk);
        }
    }
    double resolution() const { return pace.level().resolution; }
};

}  // namespace

TEST(Pace, settlesWithinTwoSecondsDoesNotSwingAndRecovers) {
    Paced paced;
    paced.run(0.9, 0.03);
    EXPECT_EQ(paced.changes, 0) << "the first second is not judged";
    paced.run(2.1, 0.03);
    EXPECT_LT(paced.resolution(), 1.0);
    const double settled = paced.resolution();
    paced.changes = 0;
    paced.run(60.0, 0.03);
    EXPECT_LE(paced.changes, 12) << "it tries to be better, ever more rarely";
    paced.changes = 0;
    paced.run(60.0, 0.03);
    EXPECT_LE(paced.changes, 4);
    EXPECT_NEAR(paced.resolution(), settled, 0.2);
    paced.run(80.0, 0.004);
    EXPECT_EQ(std::pair(paced.pace.level().mesh, paced.resolution()), std::pair(1.0, 1.0)) << "there is room again";

    // Even the coarsest level is late.
    for (const double needed : {0.06, 0.25, 0.6}) {
        Paced slow;
        slow.run(2.0 + needed, needed);
        EXPECT_EQ(slow.resolution(), 0.5) << needed;
        EXPECT_EQ(slow.pace.level().inkSteps, 2);
        slow.changes = 0;
        slow.run(60.0, needed);
        EXPECT_EQ(slow.changes, 0) << needed;
    }

    // Two late frames after a pause.
    for (int before = 0; before < 22; ++before) {
        Paced hitched;
        hitched.run(3.0 + before / 60.0, 0.01);
        hitched.now += 0.17;
        hitched.pace.frameDrawn(hitched.now, 0.0);
        hitched.now += 0.17;
        hitched.pace.frameDrawn(hitched.now, 0.0);
        hitched.run(0.5, 0.01);
        EXPECT_EQ(hitched.changes, 0) << before;
    }

    Paced stuck;
    stuck.run(20.0, 0.05, 0.1);
    EXPECT_EQ(stuck.resolution(), 0.5) << "no display is so slow";

    // A higher resolution would lose the ink, a finer mesh does not.
    Paced inked;
    inked.run(3.0, 0.03);
    const double kept = inked.resolution();
    inked.run(60.0, 0.004, 1.0 / 60, true);
    EXPECT_EQ(inked.resolution(), kept);
    inked.run(60.0, 0.004);
    EXPECT_EQ(inked.resolution(), 1.0);

    Paced slowDisplay;
    slowDisplay.run(12.0, 0.01, 1.0 / 30);
    EXPECT_EQ(slowDisplay.resolution(), 1.0) << "a display of 30 Hz gains nothing by less";
    Paced fast;
    for (const double needed : {0.004, 0.012}) fast.run(4.0, needed, 1.0 / 120);
    EXPECT_EQ(fast.changes, 0) << "60 frames a second are enough, also where 120 were possible";
    for (const double rate : {90.0, 144.0}) {
        Paced slower;
        for (const double needed : {0.004, 0.016}) slower.run(4.0, needed, 1.0 / rate);
        EXPECT_GT(slower.changes, 0) << "45 and 48 are not";
    }
    Paced fixed;
    fixed.pace.allowResolution(false);
    fixed.run(5.0, 0.018);
    EXPECT_EQ(std::pair(fixed.pace.level().mesh, fixed.resolution()), std::pair(0.5, 1.0)) << "only the mesh";
    fixed.run(5.0, 0.03);
    EXPECT_EQ(fixed.pace.level().mesh, 1.0) << "which is as fine as it can be where that does not help";
}
