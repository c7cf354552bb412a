// SPDX-License-Identifier: MIT

// A plug-in of a host's engine as a destination, by nothing but what hosts have.

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <vector>

#include "ostinet/PluginHost.h"
#include "ostinet/Setup.h"

namespace Ostinet::Testing {
namespace {

using ::testing::ElementsAre;

class Engine : public ISynapMIDIDestination {
 public:
  void HostOperation1() override {}
  void HostOperation2() override {}
  void Retain() override { ++references; }
  void Release() override { --references; }
  void Send(void const* records, int count) override {
    auto const* const bytes = static_cast<unsigned char const*>(records);
    for (int i = 0; i < count; ++i) {
      unsigned char const* const record = bytes + i * 270;
      messages.emplace_back(record + 14, record + 14 + record[10]);
    }
  }
  void Flush() override {}

  int references = 0;
  std::vector<std::vector<unsigned char>> messages;
};

class Plugin : public SynapMidiPort {
 public:
  void SetActivatedObject(Impl::SYNAP_MIDIDestImplImpl* object) override { peer = object; }
  bool IsPregen() override { return true; }
  ISynapMIDIDestination* GetDestination() override { return &engine; }

  Impl::SYNAP_MIDIDestImplImpl* peer = nullptr;
  Engine engine;
};

TEST(PluginHost, MakesPlaysAndDeletesADestination) {
  Plugin plugin;
  Ostinet::Setup& setup = Ostinet::Setup::Instance();
  Destination destination = setup.CreateSYNAPPluginDestination(&plugin, false);
  ASSERT_TRUE(destination.Exists());
  EXPECT_TRUE(destination.IsPregen());
  EXPECT_NE(setup.GetSynapPluginDestinationImpl(destination), nullptr);
  ASSERT_NE(plugin.peer, nullptr);
  SynapPeer(plugin.peer).SetManufAndModel(UString("Acme"), UString("P-1"));
  EXPECT_EQ(destination.GetModel(), UString("P-1"));
  unsigned char const note[] = {0x90, 60, 100};
  destination.SendOnePacket(DataPacket{note, 3, kNoTimeStamp});
  EXPECT_THAT(plugin.engine.messages, ElementsAre(ElementsAre(0x90, 60, 100)));
  setup.UpdateNameSetsForSYNAPPluginDestination(destination);
  setup.DeleteSYNAPPluginDestination(destination);
  EXPECT_FALSE(destination.Exists());
  EXPECT_EQ(plugin.peer, nullptr);
  EXPECT_EQ(plugin.engine.references, 0);
}

TEST(PluginHost, SendsRecordsItself) {
  Engine engine;
  unsigned char sysex[] = {0xF0, 0x7D, 0xF7};
  SendSysexToSYNAPDestination(kNoTimeStamp, sysex, 3, &engine);
  SendMIDIPacketToSYNAPDestination(DataPacket{sysex, 3, kNoTimeStamp}, &engine);
  EXPECT_THAT(engine.messages,
              ElementsAre(ElementsAre(0xF0, 0x7D, 0xF7), ElementsAre(0xF0, 0x7D, 0xF7)));
}

}  // namespace
}  // namespace Ostinet::Testing
