// SPDX-License-Identifier: MIT
//
// Unique IDs where the C library's rand has few numbers to give. This program has a rand of its
// own, which a test can tell what to draw.
#include <cstdlib>
#include <functional>
#include <random>

#include "support/StudioTest.h"

namespace Ostinet::Testing {
namespace {

std::function<int()> gDraw;
long long gDraws = 0;

class DrawnIDs : public StudioTest {
 protected:
  ~DrawnIDs() override { gDraw = nullptr; }
};

TEST_F(DrawnIDs, ANumberInUseAndZeroAreDrawnAgain) {
  Device const first = setup.MakeDevice("A");
  int const used = first._get_impl_id();
  int const numbers[] = {0, used, 0, used, 7};
  gDraw = [next = numbers]() mutable { return *next++; };
  EXPECT_EQ(setup.MakeDevice("B")._get_impl_id(), 7);
}

TEST_F(DrawnIDs, WhereEachDrawIsInUseTheSmallestFreeNumberIsTaken) {
  gDraw = [] { return 2; };
  EXPECT_EQ(setup.MakeDevice("A")._get_impl_id(), 2);
  gDraws = 0;
  EXPECT_EQ(setup.MakeDevice("B")._get_impl_id(), 1);
  EXPECT_EQ(gDraws, 100000);
  EXPECT_EQ(setup.MakeDevice("C")._get_impl_id(), 3);
}

}  // namespace

int DrawForTest() {
  static std::minstd_rand sRandom;
  ++gDraws;
  return gDraw ? gDraw() : static_cast<int>(sRandom() & 0x7FFFFFFF);
}

}  // namespace Ostinet::Testing

extern "C" int rand() noexcept { return Ostinet::Testing::DrawForTest(); }
