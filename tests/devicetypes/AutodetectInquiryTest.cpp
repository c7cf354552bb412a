// SPDX-License-Identifier: MIT
#include "AutodetectTables.h"
#include "devicetypes/AutodetectInquiry.h"

namespace Ostinet {
namespace {

using namespace Testing;
using testing::ElementsAre;

TEST(AutodetectInquiry, AsksForTheIdentity) {
  auto const request = Impl::BuildInquiryRequest({});
  ASSERT_EQ(request->messages.size(), 1u);
  EXPECT_EQ(request->messages.front(), TableOf("F0 7E ID 06 01 F7"));
}

TEST(AutodetectInquiry, KnowsManufacturersOfOneByteAndOfThree) {
  auto const request = Impl::BuildInquiryRequest({});
  ASSERT_EQ(request->responses.size(), 2u);
  EXPECT_EQ(request->responses[0]->table, TableOf("F0 7E ID 06 02 F9 FC FD FE FF"));
  EXPECT_EQ(request->responses[1]->table, TableOf("F0 7E ID 06 02 F9 FA FB FC FD FE FF"));
  for (auto const& response : request->responses) {
    EXPECT_FALSE(response->strict);
    EXPECT_TRUE(response->requests.empty());
  }
}

TEST(AutodetectInquiry, SortsTheTypesBySizeOfTheirManufacturer) {
  auto const a = TypeWithIdentity("A", "41 FF FF 00 19 00 10");
  auto const b = TypeWithIdentity("B", "00 20 29 01 02 03 04");
  auto const c = SomeType("C");
  auto const d = TypeWithIdentity("D", "43 FF FF 00 19 00 10");
  auto const request = Impl::BuildInquiryRequest({d, c, b, a});
  EXPECT_THAT(request->responses[0]->deviceTypes, ElementsAre(d, a));
  EXPECT_THAT(request->responses[1]->deviceTypes, ElementsAre(b));
}

}  // namespace
}  // namespace Ostinet
