// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <filesystem>
#include <string>

#include "core/Paths.h"
#include "core/SystemServices.h"
#include "ostinet/core/Files.h"
#include "support/Printers.h"
#include "support/TemporaryFolder.h"

namespace Ostinet {
namespace {

using SystemServices::SetEnvironment;
using Testing::TemporaryFolder;

constexpr auto kSystem = Folder::FindType(11);
constexpr auto kUser = Folder::FindType(12);

UString PathOf(TemporaryFolder const& folder, char const* name) {
  return Impl::FromPath(folder.Path() / name);
}

TEST(DataFolders, AreWhereTheVariablesSay) {
  TemporaryFolder const folder;
  folder.Write("system/a", "");
  folder.Write("user/a", "");
  SetEnvironment("OSTINET_SYSTEM_FOLDER", PathOf(folder, "system"));
  SetEnvironment("OSTINET_USER_FOLDER", PathOf(folder, "user"));
  EXPECT_EQ(Folder::Find(kSystem, Folder::CreateMode(0)).GetFullPath(), PathOf(folder, "system"));
  EXPECT_EQ(Folder::Find(kUser, Folder::CreateMode(0)).GetFullPath(), PathOf(folder, "user"));
}

TEST(DataFolders, AreCreatedOnlyWhenAskedFor) {
  TemporaryFolder const folder;
  SetEnvironment("OSTINET_USER_FOLDER", PathOf(folder, "deep/user"));
  EXPECT_FALSE(Folder::Find(kUser, Folder::CreateMode(0)).IsValid());
  EXPECT_EQ(folder.CountEntries(), 0U);
  EXPECT_TRUE(Folder::Find(kUser, Folder::CreateMode(1)).IsFolder());
  EXPECT_TRUE(Folder::Find(kUser, Folder::CreateMode(0)).IsFolder());
}

TEST(DataFolders, OfOtherTypesAreNone) {
  EXPECT_FALSE(Folder::Find(Folder::FindType(10), Folder::CreateMode(0)).IsValid());
}

// The tests run from the build tree.
TEST(DataFolders, AreThoseOfTheSourceTreeForALibraryThatRunsFromItsBuildTree) {
  SetEnvironment("OSTINET_RESOURCES", UString());
  File const file = ResourceAccess::Instance().GetFile("AutoDetect", "xml");
  EXPECT_EQ(file.GetName(), UString("AutoDetect.xml"));
  EXPECT_EQ(file.ParentFolder().GetName(), UString("resources"));
  Folder const data = file.ParentFolder().ParentFolder();
  EXPECT_EQ(data.GetName(), UString("data"));
  EXPECT_TRUE(data.ParentFolder().GetFile("CMakeLists.txt").IsFile());
}

TEST(DataFolders, OfTheUserFollowTheSystemsHabit) {
  SetEnvironment("OSTINET_USER_FOLDER", UString());
  TemporaryFolder const folder;
  UString const home = Impl::FromPath(folder.Path());
  SetEnvironment("XDG_DATA_HOME", home);
  SetEnvironment("APPDATA", home);
  Folder const user = Folder::Find(kUser, Folder::CreateMode(1));
  EXPECT_EQ(user.ParentFolder().ParentFolder(), folder.GetFolder());
}

TEST(ResourceAccess, FindsFilesByNameAndType) {
  TemporaryFolder const folder;
  File const file = folder.Write("BVDevices.xml", "");
  SetEnvironment("OSTINET_RESOURCES", Impl::FromPath(folder.Path()));
  EXPECT_EQ(ResourceAccess::Instance().GetFile("BVDevices", "xml"), file);
  EXPECT_TRUE(ResourceAccess::Instance().GetFile("BVDevices", "xml").IsFile());
  EXPECT_FALSE(ResourceAccess::Instance().GetFile("AutoDetect", "xml").IsFile());
}

TEST(SystemServices, KnowWhereTheLibraryIs) {
  EXPECT_TRUE(std::filesystem::is_directory(SystemServices::LibraryFolder()));
}

TEST(SystemServices, TellNothingOfAVariableThatIsNotSet) {
  SetEnvironment("OSTINET_TEST_VARIABLE", UString());
  EXPECT_EQ(SystemServices::Environment("OSTINET_TEST_VARIABLE"), std::nullopt);
  SetEnvironment("OSTINET_TEST_VARIABLE", UString(u"\u00E9"));
  EXPECT_EQ(SystemServices::Environment("OSTINET_TEST_VARIABLE"), UString(u"\u00E9"));
}

}  // namespace
}  // namespace Ostinet
