#include "base/flush_denormals.h"

#include <gtest/gtest.h>

#include <limits>

namespace {

bool keepsDenormals() {
    volatile float smallest = std::numeric_limits<float>::min();
    volatile float half = smallest * 0.5f;
    return half != 0.0f;
}

TEST(FlushDenormals, isActiveUntilTheOutermostScopeEnds) {
    ASSERT_TRUE(keepsDenormals());
    {
        const FlushDenormals outer;
        EXPECT_FALSE(keepsDenormals());
        { const FlushDenormals inner; }
        EXPECT_FALSE(keepsDenormals());
    }
    EXPECT_TRUE(keepsDenormals());
}

}  // namespace
