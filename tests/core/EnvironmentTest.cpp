// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include "core/SystemServices.h"
#include "ostinet/core/Environment.h"
#include "support/Printers.h"

namespace Ostinet {
namespace {

TEST(EnvironmentText, HoldsAnyLetters) {
  UString const name("Jörg 日本");
  SystemServices::SetEnvironment("OSTINET_TEST_VARIABLE", name);
  EXPECT_EQ(EnvironmentText("OSTINET_TEST_VARIABLE"), name);
  SystemServices::SetEnvironment("OSTINET_TEST_VARIABLE", UString());
}

TEST(EnvironmentText, IsEmptyForAVariableThatIsNotSet) {
  EXPECT_EQ(EnvironmentText("OSTINET_TEST_VARIABLE"), UString());
}

}  // namespace
}  // namespace Ostinet
