// SPDX-License-Identifier: MIT
#include "AutodetectTables.h"
#include "core/Paths.h"
#include "core/SystemServices.h"
#include "devicetypes/AutodetectRequests.h"
#include "support/TemporaryFolder.h"

namespace Ostinet {
namespace {

using namespace Testing;
using testing::ElementsAre;

class AutodetectRequestsOfACatalog : public testing::Test {
 protected:
  AutodetectRequestsOfACatalog() {
    SystemServices::SetEnvironment("OSTINET_RESOURCES", Impl::FromPath(folder_.Path()));
  }
  ~AutodetectRequestsOfACatalog() override {
    SystemServices::SetEnvironment("OSTINET_RESOURCES", UString());
  }

  Impl::AutodetectRequests BuildWith(std::string const& content) {
    folder_.Write("AutoDetect.xml", "<MIDIAutoDetect>" + content + "</MIDIAutoDetect>");
    return BuildAutodetectRequests(types);
  }

  static std::string RequestText(std::string const& family, std::string const& model) {
    return "<Request><RequestMIDI>F0" + family + "<DeviceID/>F7</RequestMIDI><Response>" +
           "<ResponseMIDI>F0" + family + "<DeviceID/>01</ResponseMIDI>" +
           "<Device Manufacturer='Maker' Model='" + model + "'/></Response></Request>";
  }

  Impl::DeviceTypes types;

 private:
  TemporaryFolder folder_;
};

TEST_F(AutodetectRequestsOfACatalog, AreTheInquiryAloneWithoutAFile) {
  auto const requests = BuildAutodetectRequests(types);
  ASSERT_EQ(requests.size(), 1u);
  EXPECT_EQ(requests[0]->minDeviceID, 126);
  EXPECT_EQ(requests[0]->maxDeviceID, 126);
}

TEST_F(AutodetectRequestsOfACatalog, AskTheInquiryOfTheDeviceIDsOfTypesWithAnIdentity) {
  types = {TypeWithIdentity("A", "41 FF FF 00 19 00 10"), TypeWithIDs("B", 0, 15)};
  EXPECT_EQ(BuildAutodetectRequests(types)[0]->minDeviceID, 126) << "B has no identity";
  types[0]->hasDeviceID = true;
  types[0]->minDeviceID = 16;
  types[0]->maxDeviceID = 31;
  EXPECT_EQ(BuildAutodetectRequests(types)[0]->minDeviceID, 16);
  EXPECT_EQ(BuildAutodetectRequests(types)[0]->maxDeviceID, 31);
}

TEST_F(AutodetectRequestsOfACatalog, MergeWhatTheFileAsks) {
  types = {TypeWithIDs("A", 0, 15)};
  auto const requests = BuildWith(RequestText("41", "A") + RequestText("42", "B"));
  ASSERT_EQ(requests.size(), 2u);
  EXPECT_EQ(requests[1]->messages.size(), 2u);
  EXPECT_EQ(requests[1]->minDeviceID, 0);
  EXPECT_EQ(requests[1]->maxDeviceID, 15);
}

TEST_F(AutodetectRequestsOfACatalog, CallAllWhereNoTypeOfARequestTellsItsIDs) {
  auto const requests = BuildWith(RequestText("41", "B"));
  ASSERT_EQ(requests.size(), 2u);
  EXPECT_EQ(requests[1]->minDeviceID, 127);
}

TEST_F(AutodetectRequestsOfACatalog, AddTypesBehindTheInquiryWasBuilt) {
  types = {TypeWithIdentity("A", "41 FF FF 00 19 00 10")};
  auto const requests = BuildWith(RequestText("41", "New"));
  ASSERT_EQ(types.size(), 2u);
  EXPECT_EQ(types[1]->model, "New");
  EXPECT_THAT(requests[0]->responses[0]->deviceTypes, ElementsAre(types[0]));
}

TEST_F(AutodetectRequestsOfACatalog, KeepWhatStandsBeforeAFaultOfTheFile) {
  auto const requests = BuildWith(RequestText("41", "A") + "<Request><RequestMIDI>F0 42</Req");
  ASSERT_EQ(requests.size(), 2u);
  EXPECT_EQ(requests[1]->messages.size(), 1u);
}

}  // namespace
}  // namespace Ostinet
