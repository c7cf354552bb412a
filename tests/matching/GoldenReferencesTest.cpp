// SPDX-License-Identifier: MIT
//
// References as hosts' documents hold them. These files are never rewritten: what they say must be
// read for ever.
#include <gtest/gtest.h>

#include <algorithm>
#include <string>
#include <vector>

#include "core/Paths.h"
#include "matching/HexBytes.h"
#include "ostinet/Endpoint.h"
#include "ostinet/core/Files.h"

namespace Ostinet {
namespace {

struct Golden {
  char const* file;
  char const* bytes;
  MatchObjectID type;
  char const* name;
};

Golden const kGolden[] = {
    {"external-destination.ref", Testing::kExternalDestination, MatchObjectID(4), "Pad"},
    {"internal-source.ref", Testing::kInternalSource, MatchObjectID(3), "FX"},
    {"name-only.ref", Testing::kNameOnly, MatchObjectID(4), "AB"},
    {"older-software.ref", Testing::kOlderSoftware, MatchObjectID(3), "S"},
    {"older-port.ref", Testing::kOlderPort, MatchObjectID(4), "P"},
    {"older-device.ref", Testing::kOlderDevice, MatchObjectID(4), "D"},
};

MatchData Read(std::filesystem::path const& path) {
  std::vector<unsigned char> const bytes = File(FileSpecification(Impl::FromPath(path))).Read();
  MatchData data(bytes.size());
  std::copy(bytes.begin(), bytes.end(), data.begin());
  return data;
}

TEST(GoldenReferences, AreReadForEver) {
  for (Golden const& golden : kGolden) {
    MatchData const data = Read(std::filesystem::path(OSTINET_GOLDEN_REFERENCES) / golden.file);
    EXPECT_EQ(Testing::ToHex(data), Testing::Hex(golden.bytes)) << golden.file;
    EXPECT_EQ(data.GetObjectType(), golden.type) << golden.file;
    EXPECT_EQ(data.GetObjectName(), UString(golden.name)) << golden.file;
    EXPECT_TRUE(data.GetContents().isValid) << golden.file;
  }
}

}  // namespace
}  // namespace Ostinet
