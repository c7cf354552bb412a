// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <new>
#include <stdexcept>
#include <string>

#include "ostinet/core/Error.h"
#include "support/Printers.h"

namespace Ostinet {
namespace {

VantorError ErrorOf(void (*call)()) {
  try {
    call();
  } catch (VantorError const& error) {
    return error;
  }
  return VantorError();
}

TEST(VantorError, HoldsWhatItWasMadeFrom) {
  VantorError const error("VantorThreads", "VantorJobQueue", 3, "Job cancelled");
  VantorError copy;
  copy = error;
  EXPECT_EQ(copy.Domain(), "VantorThreads");
  EXPECT_EQ(copy.Component(), "VantorJobQueue");
  EXPECT_EQ(copy.Code(), 3);
  EXPECT_EQ(copy.Text(), "Job cancelled");
  EXPECT_STREQ(copy.what(), "VantorThreads VantorJobQueue 3: Job cancelled");
}

TEST(VantorError, OfANumberBelongsToTheSystem) {
  EXPECT_EQ(VantorError(-39).Domain(), "OS");
  EXPECT_EQ(VantorError(-39).Code(), -39);
  EXPECT_EQ(VantorError(-39).Text(), "End of file");
}

TEST(Fail, ThrowsNothingForSuccess) {
  EXPECT_NO_THROW(FailOSErr(0));
  EXPECT_NO_THROW(FailWinError(0));
  EXPECT_NO_THROW(FailCOMError(0));
}

// A COM result above 0 is a success with something to say; a Windows call has no such thing.
TEST(Fail, TakesAPositiveCOMResultForSuccess) {
  EXPECT_NO_THROW(FailCOMError(1));
  EXPECT_THROW(FailWinError(1), VantorError);
}

TEST(Fail, ThrowsTheNumberThatItWasGiven) {
  EXPECT_EQ(ErrorOf([] { FailOSErr(2); }).Code(), 2);
  EXPECT_EQ(ErrorOf([] { FailOSErr(-39); }).Domain(), "OS");
  EXPECT_EQ(ErrorOf([] { FailWinError(-2005397442); }).Code(), -2005397442);
  EXPECT_EQ(ErrorOf([] { FailWinError(5); }).Domain(), "Windows");
  EXPECT_EQ(ErrorOf([] { FailCOMError(-1); }).Text(), "COM result 0xFFFFFFFF");
  EXPECT_EQ(ErrorOf([] { FailMemFullError(); }).Text(), "Out of memory");
}

template <class Exception>
VantorError CurrentErrorWhileHandling(Exception const& exception) {
  try {
    throw exception;
  } catch (...) {
    return VantorError::GetCurrentError();
  }
}

TEST(GetCurrentError, GivesTheErrorBeingHandled) {
  EXPECT_EQ(CurrentErrorWhileHandling(VantorError(7)).Code(), 7);
}

TEST(GetCurrentError, TurnsOtherExceptionsIntoErrors) {
  EXPECT_EQ(CurrentErrorWhileHandling(std::runtime_error("no luck")).Text(), "no luck");
  EXPECT_EQ(CurrentErrorWhileHandling(std::runtime_error("no luck")).Domain(), "C++");
  EXPECT_EQ(CurrentErrorWhileHandling(std::bad_alloc()).Text(), "Out of memory");
  EXPECT_EQ(CurrentErrorWhileHandling(4711).Text(), "Unknown exception");
}

TEST(GetCurrentError, IsNoErrorWhenNoneIsHandled) {
  EXPECT_EQ(VantorError::GetCurrentError().Code(), 0);
  EXPECT_EQ(VantorError::GetCurrentError().Domain(), "");
}

}  // namespace
}  // namespace Ostinet
