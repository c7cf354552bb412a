// SPDX-License-Identifier: MIT
#include <algorithm>
#include <set>

#include "devicetypes/TypeFolders.h"
#include "ostinet/DeviceTypeCatalog.h"
#include "support/TestSetup.h"
#include "support/Threads.h"

namespace Ostinet::Testing {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;

class Catalog : public TypeFolders {
 protected:
  Catalog() {
    Write("system/a.middev",
          TypesFile(TypeElement("Acme", "Synth 10") + TypeElement("Acme", "Synth 9") +
                    TypeElement("Acme", "bass") + TypeElement("Zeta", "Drum")));
  }
  static std::vector<std::string> ModelsOf(std::vector<DeviceTypeInfo> const& types) {
    std::vector<std::string> names;
    for (DeviceTypeInfo const& type : types) {
      names.push_back(type.GetModelName().string());
    }
    return names;
  }
};

TEST_F(Catalog, LooksTypesUpByExactNames) {
  Impl::DeviceTypeCatalogImpl const catalog;
  EXPECT_EQ(catalog.FindType("Acme", "Synth 9").GetModelName(), UString("Synth 9"));
  // Loading takes these for one model; a lookup does not.
  EXPECT_FALSE(catalog.FindType("ACME", "Synth 9").Exists());
  EXPECT_FALSE(catalog.FindType("Acme", "Synth9").Exists());
  EXPECT_FALSE(catalog.FindType("", "").Exists());
}

TEST_F(Catalog, GivesTypesByIndex) {
  Impl::DeviceTypeCatalogImpl const catalog;
  EXPECT_EQ(catalog.GetType(0).GetModelName(), UString("bass"));
  EXPECT_EQ(catalog.GetType(3).GetMfrName(), UString("Zeta"));
  EXPECT_FALSE(catalog.GetType(4).Exists());
  EXPECT_FALSE(catalog.GetType(-1).Exists());
}

TEST_F(Catalog, CollectsModelsSortedAsPeopleExpect) {
  Impl::DeviceTypeCatalogImpl const catalog;
  std::vector<DeviceTypeInfo> models;
  catalog.CollectModels("Acme", models);
  EXPECT_THAT(ModelsOf(models), ElementsAre("bass", "Synth 9", "Synth 10"));
  // What stood in the list before is sorted in.
  catalog.CollectModels("Zeta", models);
  EXPECT_THAT(ModelsOf(models), ElementsAre("bass", "Drum", "Synth 9", "Synth 10"));
}

TEST_F(Catalog, CollectsNoModelsOfAMakerThatDiffersInCase) {
  Impl::DeviceTypeCatalogImpl const catalog;
  std::vector<DeviceTypeInfo> models;
  catalog.CollectModels("acme", models);
  EXPECT_THAT(models, IsEmpty());
}

// The one test of the singleton, which reads its folders once in a process.
TEST_F(Catalog, IsBuiltOnceAndNeverAgain) {
  std::vector<DeviceTypeCatalog*> seen(4);
  std::vector<int> counts(4);
  RunTogether(4, [&](int i) {
    auto const index = static_cast<std::size_t>(i);
    seen[index] = &DeviceTypeCatalog::Instance();
    counts[index] = seen[index]->CountDeviceTypes();
  });
  EXPECT_EQ(std::set<DeviceTypeCatalog*>(seen.begin(), seen.end()).size(), 1U);
  EXPECT_THAT(counts, ::testing::Each(4));

  DeviceTypeCatalog const& catalog = DeviceTypeCatalog::Instance();
  EXPECT_TRUE(catalog.GetDeviceType("Zeta", "Drum").Exists());
  EXPECT_EQ(catalog.GetDeviceType(1), catalog.GetDeviceType("Acme", "Synth 10"));
  EXPECT_FALSE(catalog.GetDeviceType(4).Exists());

  sorted_vector_set<UString, std::greater<UString>> makers{UString("Other"), UString("Acme")};
  catalog.CollectManufacturers(makers);
  EXPECT_THAT(makers, ElementsAre(UString("Zeta"), UString("Other"), UString("Acme")));
  std::vector<DeviceTypeInfo> models;
  catalog.CollectModels("Acme", models);
  EXPECT_EQ(models.size(), 3U);

  Write("user/late.middev", TypesFile(TypeElement("Late", "Comer")));
  EXPECT_EQ(DeviceTypeCatalog::Instance().CountDeviceTypes(), 4);
}

TEST(DeviceTypeInfo, NullHandlesSayNothing) {
  DeviceTypeInfo const none;
  EXPECT_FALSE(none.Exists());
  EXPECT_EQ(none.GetMfrName(), UString());
  EXPECT_EQ(none.GetModelName(), UString());
  EXPECT_EQ(none.GetImplPtr(), nullptr);
  EXPECT_FALSE(none.MatchesDevice(Device()));
  EXPECT_EQ(none, DeviceTypeInfo(RCPtrMT<Impl::DeviceTypeInfoImpl>()));
}

TEST(DeviceTypeInfo, HandlesAreEqualByTheirObject) {
  DeviceTypeInfo const one(new Impl::DeviceTypeInfoImpl("Acme", "Synth"));
  DeviceTypeInfo const twin(new Impl::DeviceTypeInfoImpl("Acme", "Synth"));
  DeviceTypeInfo copy(one);
  EXPECT_EQ(copy, one);
  EXPECT_NE(one, twin);
  copy = twin;
  EXPECT_EQ(copy, twin);
  EXPECT_EQ(copy.GetModelName(), UString("Synth"));
}

TEST(DeviceTypeInfo, MatchesDevicesOfExactlyItsMakerAndModel) {
  TestSetup& setup = TestSetup::Get();
  setup.Reset();
  Device const device = setup.MakeDevice("Lead");
  DeviceTypeInfo const type(new Impl::DeviceTypeInfoImpl("Acme", "Synth"));
  EXPECT_FALSE(type.MatchesDevice(device));
  EXPECT_FALSE(type.MatchesDevice(Device()));
  device.SetManufacturer("Acme");
  device.SetModel("synth");
  EXPECT_FALSE(type.MatchesDevice(device));
  device.SetModel("Synth");
  EXPECT_TRUE(type.MatchesDevice(device));
  setup.Reset();
}

/// The files that ship.
class ShippedTypes : public TypeFolders {
 protected:
  ShippedTypes() {
    SystemServices::SetEnvironment("OSTINET_SYSTEM_FOLDER", OSTINET_SHIPPED_DATA "/midi-devices");
  }
};

/// Checks each file that it is shown.
class CheckingVisitor : public Impl::XMLFilesVisitor {
 public:
  void Visit(File const& file, bool) override {
    DeviceTypeFileCheck const check = CheckDeviceTypeFile(file);
    EXPECT_THAT(check.notes, IsEmpty()) << file.GetName().string();
    EXPECT_EQ(check.author, UString("Ostinet"));
    types += check.types.size();
    ++files;
  }
  std::size_t types = 0;
  std::size_t files = 0;
};

TEST_F(ShippedTypes, AreReadWithoutOneThingPassedOver) {
  CheckingVisitor visitor;
  Impl::VisitXMLFiles(visitor, "middev");
  EXPECT_GT(visitor.files, 30U);
  EXPECT_GT(visitor.types, 400U);
  EXPECT_EQ(Impl::ReadDeviceTypeFiles().size(), visitor.types);
}

TEST_F(ShippedTypes, NoTwoShareAnIdentity) {
  std::set<std::vector<int>> identities;
  for (auto const& type : Impl::ReadDeviceTypeFiles()) {
    if (!(type->inquiryResponse == ModelInfo())) {
      unsigned char const* const bytes = type->inquiryResponse.bytes;
      EXPECT_TRUE(identities.emplace(bytes, bytes + 7).second) << type->model.string();
    }
  }
  EXPECT_GT(identities.size(), 200U);
}

TEST_F(ShippedTypes, SayWhatTheTablesSay) {
  Impl::DeviceTypeCatalogImpl const catalog;
  Impl::DeviceTypeInfoImpl const* const synth = catalog.FindType("Roland", "V-Synth").GetImplPtr();
  ASSERT_NE(synth, nullptr);
  EXPECT_THAT(synth->inquiryResponse.bytes, ElementsAre(0x41, 0xFF, 0xFF, 0x53, 0x01, 0, 0));
  EXPECT_EQ(synth->minDeviceID, 0x10);
  EXPECT_EQ(synth->maxDeviceID, 0x1F);
  EXPECT_EQ(synth->portGroups.size(), 1U);
  EXPECT_EQ(synth->transmits.flags[3], Impl::TriBool::kTrue);

  Impl::DeviceTypeInfoImpl const* const box = catalog.FindType("Akai", "MPC60").GetImplPtr();
  ASSERT_NE(box, nullptr);
  ASSERT_EQ(box->portGroups.size(), 4U);
  EXPECT_EQ(box->portGroups[1].ins.size(), 1U);
  EXPECT_EQ(box->portGroups[2].ins.size(), 0U);
  EXPECT_EQ(box->portGroups[3].outs.size(), 1U);
  EXPECT_EQ(box->capabilities[3], Impl::TriBool::kTrue);  // a sampler
  EXPECT_EQ(box->capabilities[4], Impl::TriBool::kTrue);  // and a drum machine
  EXPECT_EQ(box->capabilities[5], Impl::TriBool::kUnset);

  // One of four models whose replies differ in their revision at most.
  Impl::DeviceTypeInfoImpl const* const piano = catalog.FindType("Roland", "FP-30X").GetImplPtr();
  ASSERT_NE(piano, nullptr);
  EXPECT_EQ(piano->inquiryResponse, ModelInfo());
}

}  // namespace
}  // namespace Ostinet::Testing
