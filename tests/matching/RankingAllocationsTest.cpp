// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include "support/AllocationCounter.h"
#include "support/TestSetup.h"

namespace Ostinet {
namespace {

// A host compares each of its references with each endpoint.
TEST(EndpointRanking, AllocatesNothingOnceItHasSeenTheNames) {
  Testing::TestSetup& setup = Testing::TestSetup::Get();
  setup.Reset();
  Destination const port = setup.MakePort("An interface with a rather long name, port 1");
  port.SetManufacturer("A manufacturer with a rather long name");
  port.SetModel("A model with a rather long name");
  Destination const other = setup.MakePort("Another interface with a long name, port 1");
  MatchData const data = port.GetMatchData();
  ObjectMatch const first = port.MatchToData(data);
  other.MatchToData(data);
  Testing::AllocationCounter const allocations;
  EXPECT_EQ(port.MatchToData(data), first);
  other.MatchToData(data);
  EXPECT_EQ(allocations.Count(), 0u);
  setup.Reset();
}

}  // namespace
}  // namespace Ostinet
