// SPDX-License-Identifier: MIT
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "platform/system/native/PortTable.h"
#include "system/native/FakeService.h"

namespace Ostinet::Testing {
namespace {

using Impl::PortDirection;
using ::testing::ElementsAre;

class PortTable : public ::testing::Test {
 protected:
  std::vector<std::u16string> Names(PortDirection direction = PortDirection::kOutput) {
    std::vector<std::u16string> names;
    for (auto const& port : table_.Present(direction)) names.push_back(port.name);
    return names;
  }

  std::shared_ptr<FakeService> service_ = std::make_shared<FakeService>();
  Impl::PortTable table_{{service_}};
};

TEST_F(PortTable, CountsAChangeOnlyWhenWhatIsSeenDiffers) {
  unsigned const empty = table_.Refresh();
  service_->outputs = {{"20:0", "Keys"}};
  unsigned const one = table_.Refresh();
  EXPECT_NE(one, empty);
  EXPECT_EQ(table_.Refresh(), one);
  service_->outputs = {{"20:0", "Keys 88"}};
  EXPECT_EQ(table_.Refresh(), one) << "a port's name is what it was first seen under";
  service_->outputs.clear();
  EXPECT_NE(table_.Refresh(), one);
}

TEST_F(PortTable, TellsTwoPortsOfOneNameApartInTheirOrder) {
  service_->outputs = {{"20:0", "Keys"}, {"24:0", "Keys"}, {"28:0", "Keys"}};
  table_.Refresh();
  EXPECT_THAT(Names(), ElementsAre(u"Keys", u"Keys 2", u"Keys 3"));
}

TEST_F(PortTable, ATwinKeepsItsNameWhenTheOtherGoes) {
  service_->outputs = {{"20:0", "Keys"}, {"24:0", "Keys"}};
  table_.Refresh();
  service_->outputs = {{"24:0", "Keys"}};
  table_.Refresh();
  EXPECT_THAT(Names(), ElementsAre(u"Keys 2"));
  service_->outputs = {{"20:0", "Keys"}, {"24:0", "Keys"}};
  table_.Refresh();
  EXPECT_THAT(Names(), ElementsAre(u"Keys", u"Keys 2"));
}

TEST_F(PortTable, AReplugUnderAnotherAddressIsTheSameDevice) {
  service_->outputs = {{"20:0", "Keys"}, {"24:0", "Pads"}};
  table_.Refresh();
  service_->outputs = {{"24:0", "Pads"}};
  table_.Refresh();
  EXPECT_FALSE(table_.Find(PortDirection::kOutput, 0).has_value());
  service_->outputs = {{"24:0", "Pads"}, {"32:0", "Keys"}};
  table_.Refresh();
  ASSERT_TRUE(table_.Find(PortDirection::kOutput, 0).has_value());
  EXPECT_EQ(table_.Find(PortDirection::kOutput, 0)->id, "32:0");
  EXPECT_EQ(table_.Find(PortDirection::kOutput, 1)->id, "24:0");
}

TEST_F(PortTable, AReturningPortWhoseNameIsTakenGetsAnother) {
  service_->outputs = {{"20:0", "Keys"}};
  table_.Refresh();
  service_->outputs = {{"32:0", "Keys"}};
  table_.Refresh();
  EXPECT_THAT(Names(), ElementsAre(u"Keys"));
  service_->outputs = {{"20:0", "Keys"}, {"32:0", "Keys"}};
  table_.Refresh();
  EXPECT_THAT(Names(), ElementsAre(u"Keys", u"Keys 2"));
  EXPECT_EQ(table_.Find(PortDirection::kOutput, 0)->id, "32:0");
}

// A scan that takes the number of outputs for both directions has to reach every input.
TEST_F(PortTable, CountsTheLargerDirectionForBoth) {
  service_->outputs = {{"20:0", "Keys"}};
  service_->inputs = {{"20:0", "Keys"}, {"24:0", "Pads"}, {"28:0", "Faders"}};
  table_.Refresh();
  EXPECT_EQ(table_.Count(), 3U);
  EXPECT_TRUE(table_.Find(PortDirection::kInput, 2).has_value());
  EXPECT_FALSE(table_.Find(PortDirection::kOutput, 2).has_value());
  EXPECT_FALSE(table_.Find(PortDirection::kOutput, ~std::uintptr_t{0}).has_value());
}

TEST_F(PortTable, PortsOfADeadServiceAreAway) {
  service_->outputs = {{"20:0", "Keys"}};
  table_.Refresh();
  service_->alive = false;
  table_.Refresh();
  EXPECT_TRUE(Names().empty());
}

}  // namespace
}  // namespace Ostinet::Testing
