// SPDX-License-Identifier: MIT
//
// What must not get slow as the studio grows, counted in reads of properties, not in seconds.
#include "model/PropertyKeys.h"
#include "support/StudioTest.h"

namespace Ostinet::Testing {
namespace {

using Impl::EndpointKind;
using Impl::ImplOf;

/// Counts the reads of all such peers.
class CountingPeer : public TestPeer {
 public:
  using TestPeer::TestPeer;
  bool GetInt(UString const& key, int& out) const override {
    ++sReads;
    return TestPeer::GetInt(key, out);
  }
  static long sReads;
};

long CountingPeer::sReads = 0;

class LargeStudioTest : public StudioTest {
 protected:
  void Make(int count, bool isDirect) {
    for (int i = 0; i < count; ++i) {
      RCPtrMT<Impl::DestinationImpl> destination(new Impl::DestinationImpl(
          std::make_unique<CountingPeer>(setup), setup, EndpointKind::Bare(isDirect, false)));
      setup.GetStudio().destinations.push_back(destination);
      setup.MaybeAssignUniqueID(*destination);
    }
  }
  static long Reads(std::function<void()> const& work) {
    CountingPeer::sReads = 0;
    work();
    return CountingPeer::sReads;
  }
};

TEST_F(LargeStudioTest, NewObjectsGetTheirIDsWithoutAWalkOverTheStudio) {
  int const count = 2000;
  EXPECT_LT(Reads([&] { Make(count, true); }), 20L * count);
}

TEST_F(LargeStudioTest, ConnectionsAreWorkedOutInARoundOverTheStudio) {
  int const count = 2000;
  Make(count, true);
  Make(count, false);
  for (int i = 0; i < count; ++i) {
    int const id = setup.GetDestination(2 * count - 1 - i).GetUniqueID();
    TestSetup::PeerOf(setup.GetDestination(i)).SetIntList("connUniqueID", {id});
  }
  EXPECT_LT(Reads([&] { setup.UpdateConnections(); }), 10L * count);
  for (int i = 0; i < count; ++i) {
    ASSERT_TRUE(setup.GetDestination(i).GetConnectedDestination(0) ==
                setup.GetDestination(2 * count - 1 - i));
  }
}

TEST_F(LargeStudioTest, ManyEndpointsOfOneIDAreSharedOutInARoundOverTheStudio) {
  int const count = 1000;
  Make(count, true);
  Make(count, false);
  for (int i = 0; i < count; ++i) {
    TestSetup::PeerOf(setup.GetDestination(i)).SetIntList("connUniqueID", {7});
    TestSetup::SetInt(setup.GetDestination(count + i), "uniqueID", 7);
  }
  EXPECT_LT(Reads([&] { setup.UpdateConnections(); }), 10L * count);
  EXPECT_TRUE(setup.GetDestination(count - 1).GetConnectedDestination(0) ==
              setup.GetDestination(2 * count - 1));
}

}  // namespace
}  // namespace Ostinet::Testing
