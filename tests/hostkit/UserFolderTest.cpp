// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include "core/SystemServices.h"
#include "ostinet/core/Environment.h"
#include "ostinet/hostkit/FolderPrefs.h"
#include "support/Printers.h"

namespace Ostinet {
namespace {

/// The variables that say where settings belong, which are as they were afterwards.
class UserFolder : public testing::Test {
 protected:
  static constexpr char const* kVariables[] = {"XDG_CONFIG_HOME", "APPDATA", "HOME"};

  UserFolder() {
    for (std::size_t i = 0; i < 3; ++i) {
      before_[i] = EnvironmentText(kVariables[i]);
      Set(kVariables[i], UString());
    }
  }
  ~UserFolder() override {
    for (std::size_t i = 0; i < 3; ++i) {
      Set(kVariables[i], before_[i]);
    }
  }

  static void Set(char const* variable, UString const& value) {
    SystemServices::SetEnvironment(variable, value);
  }
  static Folder Below(UString const& path, UString const& name) {
    return Folder(FileSpecification(path)).GetSubFolder(name);
  }

 private:
  UString before_[3];
};

TEST_F(UserFolder, IsWhereTheFirstVariableThatIsSetSays) {
  UString const home("/home/Jörg");
  Set("HOME", home);
  EXPECT_EQ(FolderPrefs::UserFolder("My Host"), Below(home + "/.config", "my host"));
  Set("APPDATA", home + "/Roaming");
  EXPECT_EQ(FolderPrefs::UserFolder("My Host"), Below(home + "/Roaming", "My Host"));
  Set("XDG_CONFIG_HOME", home + "/xdg");
  EXPECT_EQ(FolderPrefs::UserFolder("My Host"), Below(home + "/xdg", "my host"));
}

TEST_F(UserFolder, IsNoneWhereNoVariableIsSet) {
  EXPECT_FALSE(FolderPrefs::UserFolder("My Host").IsValid());
}

}  // namespace
}  // namespace Ostinet
