// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <functional>
#include <string>
#include <system_error>

#include "core/AtomicFile.h"
#include "ostinet/core/Error.h"
#include "ostinet/core/XML.h"
#include "support/Printers.h"
#include "support/TemporaryFolder.h"

namespace Ostinet {
namespace {

using Impl::AtomicFile;
using Testing::TemporaryFolder;

/// Lets the n-th step fail, counted from 0.
class FailingStep {
 public:
  explicit FailingStep(int index) {
    AtomicFile::SetFaultHook([this, index](AtomicFile::Step) {
      return steps_++ == index ? static_cast<int>(std::errc::no_space_on_device) : 0;
    });
  }
  ~FailingStep() { AtomicFile::SetFaultHook({}); }
  int CountSteps() const { return steps_; }

 private:
  int steps_ = 0;
};

TEST(AtomicFile, ReplacesTheContent) {
  TemporaryFolder const folder;
  File const file = folder.Write("a.txt", "old and longer");
  file.Replace("new", 3);
  EXPECT_EQ(folder.Read("a.txt"), "new");
  EXPECT_EQ(folder.CountEntries(), 1U);
}

TEST(AtomicFile, MakesAFileThatWasNotThere) {
  TemporaryFolder const folder;
  folder.GetFolder().GetFile("new.txt").Replace("x", 1);
  EXPECT_EQ(folder.Read("new.txt"), "x");
}

TEST(AtomicFile, LeavesTheOldFileUnlessItIsCommitted) {
  TemporaryFolder const folder;
  folder.Write("a.txt", "old");
  {
    AtomicFile file(folder.Path() / "a.txt");
    file.Write("new", 3);
    EXPECT_EQ(folder.Read("a.txt"), "old");
  }
  EXPECT_EQ(folder.Read("a.txt"), "old");
  EXPECT_EQ(folder.CountEntries(), 1U);
}

TEST(AtomicFile, ThrowsWhereNoFileCanBe) {
  TemporaryFolder const folder;
  EXPECT_THROW(folder.GetFolder().GetSubFolder("missing").GetFile("a").Replace("x", 1),
               VantorError);
}

TEST(AtomicFile, LeavesTheOldFileWholeWhateverFails) {
  TemporaryFolder const folder;
  File const file = folder.Write("a.txt", "old");
  int failed = 0;
  for (bool done = false; !done; ++failed) {
    FailingStep const step(failed);
    try {
      file.Replace("new", 3);
      done = true;
    } catch (VantorError const& error) {
      EXPECT_EQ(error.Code(), static_cast<int>(std::errc::no_space_on_device));
      EXPECT_EQ(folder.Read("a.txt"), "old");
    }
    EXPECT_EQ(folder.CountEntries(), 1U);
  }
  EXPECT_EQ(failed, 6);  // create, write, flush, close, replace; then none
  EXPECT_EQ(folder.Read("a.txt"), "new");
}

TEST(XMLWriterFaults, LeavesTheOldFileWholeWhateverFails) {
  TemporaryFolder const folder;
  File const file = folder.Write("a.xml", "<Old/>");
  UString longText;
  longText.append(100'000, u'x');  // more than is kept in memory, so that writes are many
  int failed = 0;
  for (bool done = false; !done; ++failed) {
    FailingStep const step(failed);
    try {
      XMLLib::Writer writer(file);
      writer.StartElement("New");
      writer.Element("A", longText);
      writer.Element("B", longText);
      writer.Close();
      done = true;
    } catch (VantorError const&) {
      EXPECT_EQ(folder.Read("a.xml"), "<Old/>");
    }
    EXPECT_EQ(folder.CountEntries(), 1U);
  }
  EXPECT_GT(failed, 6);
  EXPECT_GT(folder.Read("a.xml").size(), 200'000U);
}

TEST(XMLWriterFaults, KeepsTheOldFileInSilenceWhenItsEndFails) {
  TemporaryFolder const folder;
  File const file = folder.Write("a.xml", "<Old/>");
  {
    XMLLib::Writer writer(file);
    writer.StartElement("New");
    AtomicFile::SetFaultHook([](AtomicFile::Step) { return 28; });
  }
  AtomicFile::SetFaultHook({});
  EXPECT_EQ(folder.Read("a.xml"), "<Old/>");
  EXPECT_EQ(folder.CountEntries(), 1U);
}

TEST(XMLWriterFaults, FailsAtItsCloseAgainAfterAFailure) {
  TemporaryFolder const folder;
  XMLLib::Writer writer(folder.GetFolder().GetFile("a.xml"));
  writer.StartElement("New");
  {
    FailingStep const step(0);
    EXPECT_THROW(writer.Close(), VantorError);
  }
  EXPECT_THROW(writer.Close(), VantorError);
  EXPECT_EQ(folder.CountEntries(), 0U);
}

}  // namespace
}  // namespace Ostinet
