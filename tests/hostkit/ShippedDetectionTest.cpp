// SPDX-License-Identifier: MIT
//
// What ships is enough to recognise what the tables know: every identity and every request of a
// maker's own, row by row.
#include <algorithm>
#include <cstdio>
#include <fstream>
#include <map>
#include <set>
#include <sstream>

#include "core/Paths.h"
#include "core/SystemServices.h"
#include "hostkit/DetectionTest.h"
#include "support/TemporaryFolder.h"

namespace Ostinet {
namespace {

using namespace Testing;

using Row = std::map<std::string, std::string>;

std::vector<std::string> Split(std::string const& line, char separator) {
  std::vector<std::string> cells;
  std::stringstream stream(line);
  for (std::string cell; std::getline(stream, cell, separator);) {
    cells.push_back(cell);
  }
  return cells;
}

std::vector<Row> ReadTable(std::string const& name) {
  std::ifstream stream(OSTINET_TABLES "/" + name);
  std::vector<std::string> headings;
  std::vector<Row> rows;
  for (std::string line; std::getline(stream, line);) {
    if (!line.empty() && line.back() == '\r') {
      line.pop_back();
    }
    if (line.empty() || line[0] == '#') {
      continue;
    }
    auto const cells = Split(line, '\t');
    if (headings.empty()) {
      headings = cells;
      continue;
    }
    Row row;
    for (std::size_t i = 0; i < headings.size(); ++i) {
      row[headings[i]] = i < cells.size() ? cells[i] : "";
    }
    rows.push_back(row);
  }
  return rows;
}

// The models that a row means.
std::set<std::string> ModelsOfRow(Row const& row) {
  static std::vector<Row> const groups = ReadTable("model_groups.tsv");
  for (Row const& group : groups) {
    if (group.at("Manufacturer") == row.at("Manufacturer") && group.at("Row") == row.at("Model")) {
      auto const models = Split(group.at("Models"), '|');
      return {models.begin(), models.end()};
    }
  }
  return {row.at("Model")};
}

// Bytes for `text`: "ID" and "ID+0xNN" become the device ID, "??" some byte.
Bytes Concrete(std::string const& text, int deviceID) {
  Bytes bytes;
  for (std::string const& word : Split(text, ' ')) {
    int const offset = word.size() > 3 ? std::stoi(word.substr(3), nullptr, 16) : 0;
    int const byte = word.rfind("ID", 0) == 0 ? deviceID + offset
                     : word == "??"           ? 0x11
                                              : std::stoi(word, nullptr, 16);
    bytes.push_back(static_cast<unsigned char>(byte));
  }
  return bytes;
}

std::string HexOf(Bytes const& bytes) {
  std::string text;
  char digits[4];
  for (unsigned char const byte : bytes) {
    std::snprintf(digits, sizeof digits, "%02X ", unsigned{byte});
    text += digits;
  }
  return text;
}

class ShippedDetection : public DetectionTest {
 protected:
  // No files of the user's own, and those of the tree for the machine's.
  ShippedDetection() {
    SystemServices::SetEnvironment("OSTINET_USER_FOLDER", Impl::FromPath(empty_.Path()));
  }
  ~ShippedDetection() override { SystemServices::SetEnvironment("OSTINET_USER_FOLDER", UString()); }

  // The findings of a run that hears this reply at its beginning.
  Findings Hear(Bytes const& reply) {
    DetectionRun& run = Begin();
    DataPacket packet;
    packet.data = reply.data();
    packet.length = reply.size();
    run.HandlePacket(packet, Src("In 1"));
    run.Cancel();
    return run.Ports().at(0).findings;
  }

  static bool IsNamed(DetectionRun::Finding const& finding, Row const& row) {
    std::set<std::string> const models = ModelsOfRow(row);
    return std::any_of(finding.types.begin(), finding.types.end(), [&](DeviceTypeInfo const& type) {
      return type.GetMfrName().string() == row.at("Manufacturer") &&
             models.count(type.GetModelName().string()) != 0;
    });
  }

 private:
  TemporaryFolder empty_;
};

std::string IdentityText(Row const& row) {
  return row.at("ManufacturerID") + " " + row.at("Family (wire order)") + " " +
         row.at("Member (wire order)");
}

TEST_F(ShippedDetection, NamesOnlyTypesOfTheDeviceTypeFiles) {
  DeviceTypeCatalog const& catalog = DeviceTypeCatalog::Instance();
  ASSERT_GT(catalog.CountDeviceTypes(), 400);
  // Types that no file describes stand behind the sorted ones.
  auto const key = [&](int index) {
    DeviceTypeInfo const type = catalog.GetDeviceType(index);
    return std::make_pair(type.GetMfrName(), type.GetModelName());
  };
  for (int i = 1; i < catalog.CountDeviceTypes(); ++i) {
    auto const before = key(i - 1);
    auto const here = key(i);
    bool const isSorted = before.first.equal(here.first, UString::kCatalogKey)
                              ? before.second.less(here.second, UString::kCatalogKey)
                              : before.first.less(here.first, UString::kCatalogKey);
    EXPECT_TRUE(isSorted) << here.first.string() << " " << here.second.string();
  }
}

TEST_F(ShippedDetection, RecognisesEveryIdentityOfTheTables) {
  auto const rows = ReadTable("inquiry.tsv");
  ASSERT_GT(rows.size(), 300u);
  for (Row const& row : rows) {
    std::string const revision = row.at("Revision bytes as read");
    Bytes const reply = Concrete("F0 7E 05 06 02 " + IdentityText(row) + " " +
                                     (revision.empty() ? "00 00 00 00" : revision) + " F7",
                                 0);
    auto const findings = Hear(reply);
    ASSERT_EQ(findings.size(), 1u) << row.at("Manufacturer") << " " << row.at("Model");
    EXPECT_TRUE(IsNamed(findings[0], row))
        << row.at("Manufacturer") << " " << row.at("Model") << ": " << ModelsOf(findings[0]);
    EXPECT_EQ(findings[0].deviceID, 5);
  }
}

// Of those that share an identity, the revision tells which one it is.
TEST_F(ShippedDetection, TellsInstrumentsOfOneIdentityApart) {
  auto const rows = ReadTable("inquiry.tsv");
  int tested = 0;
  for (Row const& row : rows) {
    if (row.at("Note").find("told apart by the revision bytes shown") == std::string::npos) {
      continue;
    }
    auto const findings = Hear(Concrete(
        "F0 7E 05 06 02 " + IdentityText(row) + " " + row.at("Revision bytes as read") + " F7", 0));
    ASSERT_EQ(findings.size(), 1u) << row.at("Model");
    EXPECT_EQ(ModelsOf(findings[0]), row.at("Model"));
    ++tested;
  }
  EXPECT_GT(tested, 50);
}

TEST_F(ShippedDetection, RecognisesEveryAnswerOfTheTables) {
  auto const rows = ReadTable("detect.tsv");
  ASSERT_GT(rows.size(), 70u);
  int named = 0;
  for (Row const& row : rows) {
    if (row.at("Model") == "MKS-80") {
      continue;  // its exchange takes two messages
    }
    auto const findings = Hear(Concrete(row.at("Reply prefix") + " 11 11 11 F7", 3));
    ASSERT_EQ(findings.size(), 1u) << row.at("Manufacturer") << " " << row.at("Model");
    // Two families share the reply, and are told apart by what they were asked.
    bool const isShared = row.at("Manufacturer") == "Casio" || row.at("Model") == "K3 / K3m";
    EXPECT_TRUE(isShared || IsNamed(findings[0], row))
        << row.at("Manufacturer") << " " << row.at("Model") << ": " << ModelsOf(findings[0]);
    named += IsNamed(findings[0], row) ? 1 : 0;
  }
  EXPECT_GE(named, static_cast<int>(rows.size()) - 4);
}

TEST_F(ShippedDetection, AsksEveryRequestOfTheTables) {
  RunAll();
  std::vector<Bytes> const sent = SentTo("Out 1");
  std::set<Bytes> const messages(sent.begin(), sent.end());
  EXPECT_EQ(messages.size(), sent.size()) << "nothing is asked twice";
  for (Row const& row : ReadTable("detect.tsv")) {
    bool wasAsked = false;
    for (int id = 0; id < 128 && !wasAsked; ++id) {
      wasAsked = messages.count(Concrete(row.at("Request"), id)) != 0;
    }
    EXPECT_EQ(wasAsked, row.at("Model") != "MKS-80")
        << row.at("Manufacturer") << " " << row.at("Model");
  }
}

// Where the tables tell the device IDs, each of them is asked.
TEST_F(ShippedDetection, AsksEveryDeviceIDThatATypeMayHave) {
  RunAll();
  std::vector<Bytes> const sent = SentTo("Out 1");
  std::set<Bytes> const messages(sent.begin(), sent.end());
  std::map<std::string, Row> requests;
  for (Row const& row : ReadTable("detect.tsv")) {
    requests[row.at("Manufacturer") + "/" + row.at("Model")] = row;
  }
  int asked = 0;
  for (Row const& ids : ReadTable("device_ids.tsv")) {
    auto const request = requests.find(ids.at("Manufacturer") + "/" + ids.at("Model"));
    if (request == requests.end()) {
      continue;
    }
    std::string const text = request->second.at("Request");
    int const first = std::stoi(ids.at("First"), nullptr, 16);
    int const last = std::stoi(ids.at("Last"), nullptr, 16);
    // An offset that the device ID of the wire holds already.
    int const base = text.find("ID+0x10") != std::string::npos ? first : 0;
    for (int id = first; id <= last; ++id) {
      EXPECT_EQ(messages.count(Concrete(text, id - base)), 1u) << text << " " << id;
      ++asked;
    }
  }
  EXPECT_GT(asked, 300);
}

// The whole road: instruments behind ports, twenty-five on each with IDs of their own, since all of
// them answer at once and an input takes no more than its buffers.
TEST_F(ShippedDetection, FindsTheInstrumentsOfTheTablesBehindPorts) {
  constexpr std::size_t kOnEachPort = 25;
  auto const rows = ReadTable("inquiry.tsv");
  for (std::size_t i = 0; i < rows.size(); ++i) {
    std::string const number = std::to_string(i / kOnEachPort + 1);
    if (i % kOnEachPort == 0 && i != 0) {
      AddPair(number);
    }
    SimulatedInstrument instrument;
    instrument.out = "Out " + number;
    instrument.in = "In " + number;
    instrument.deviceID = static_cast<int>(i % kOnEachPort);
    instrument.identity =
        HexOf(Concrete(IdentityText(rows[i]) + " " + rows[i].at("Revision bytes as read"), 0));
    midi.AddInstrument(instrument);
  }
  RunAll();
  std::size_t found = 0;
  for (DetectionRun::Port const& port : Run().Ports()) {
    auto const number = std::stoul(port.destination.GetName().string().substr(4)) - 1;
    for (DetectionRun::Finding const& finding : port.findings) {
      std::size_t const place = number * kOnEachPort + static_cast<std::size_t>(finding.deviceID);
      ASSERT_LT(place, rows.size());
      EXPECT_TRUE(IsNamed(finding, rows[place]))
          << rows[place].at("Model") << ": " << ModelsOf(finding);
      ++found;
    }
  }
  EXPECT_EQ(found, rows.size());
}

}  // namespace
}  // namespace Ostinet
