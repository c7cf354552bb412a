// SPDX-License-Identifier: MIT
//
// Random studios, saved and loaded again and again.
#include <fstream>
#include <iterator>
#include <map>
#include <random>
#include <regex>

#include "model/DestinationImpl.h"
#include "model/Handles.h"
#include "model/SelfStorageImplImpl.h"
#include "platform/PlatformTest.h"

namespace Ostinet::Testing {
namespace {

using Impl::ImplOf;
using Impl::PropertyDict;
using Impl::PropertyPath;

class RandomStudio : public PlatformTest {
 protected:
  int Draw(int count) { return std::uniform_int_distribution<int>(0, count - 1)(random_); }

  /// All that a text can hold: markup, white space, letters beyond one unit.
  UString DrawText() {
    static char const* const kPieces[] = {"Synth", "<&>\"'", " ",   "\t", "\n", "é",
                                          "日本",  "𝄞",      "]]>", "0",  "--", ""};
    UString text;
    for (int i = Draw(5); i > 0; --i) {
      text += UString(kPieces[Draw(12)]);
    }
    return text;
  }

  UString PathOf(char const* name) const { return (prefs.folder / name).u16string(); }

  PropertyDict DrawDict(int depth) {
    PropertyDict dict;
    for (int i = Draw(4); i > 0; --i) {
      UString const key = DrawText();
      switch (Draw(depth > 0 ? 4 : 3)) {
        case 0:
          dict.entries[key] = DrawText();
          break;
        case 1:
          dict.entries[key] = std::vector<UString>{DrawText(), DrawText()};
          break;
        case 2:
          dict.entries[key] = PropertyPath{PathOf("a b.midnam")};
          break;
        case 3:
          dict.entries[key] = DrawDict(depth - 1);
          break;
      }
    }
    return dict;
  }

  void DrawProperties(DeviceObject const& object) {
    Impl::ImplImpl& peer = *ImplOf(object)->Peer();
    for (int i = Draw(6); i > 0; --i) {
      UString const key = UString("key ") + DrawText();
      switch (Draw(5)) {
        case 0:
          peer.SetInt(key, static_cast<int>(random_()));
          break;
        case 1:
          peer.SetString(key, DrawText());
          break;
        case 2:
          peer.SetIntList(key, {Draw(9), -Draw(9)});
          break;
        case 3:
          peer.SetDict(key, DrawDict(3));
          break;
        case 4:
          peer.SetFile(key, PathOf("x.png"));
          break;
      }
    }
    object.SetSupportsMMC(Draw(2) == 0);
  }

  void DrawPorts() {
    for (int i = Draw(4) + 1; i > 0; --i) {
      AddOut("Out " + std::to_string(i));
      AddIn("In " + std::to_string(i));
    }
  }

  void DrawStudio() {
    for (int i = Draw(5) + 1; i > 0; --i) {
      Device const device = setup.CreateDevice(DrawText());
      DrawProperties(device);
      for (int entities = Draw(3); entities > 0; --entities) {
        setup.CreateEntity(device, DrawText(), Draw(3), Draw(3));
      }
      for (int entity = 0; entity < device.CountEntities(); ++entity) {
        DrawProperties(device.GetEntity(entity));
      }
    }
    DrawConnections();
  }

  void DrawConnections() {
    std::vector<Destination> ports, instruments;
    for (int i = 0; i < setup.CountDestinations(); ++i) {
      Destination const destination = setup.GetDestination(i);
      (destination.IsDirect() ? ports : instruments).push_back(destination);
      DrawProperties(destination);
    }
    for (Destination const& instrument : instruments) {
      if (Draw(2) == 0) {
        ports[static_cast<std::size_t>(Draw(static_cast<int>(ports.size())))]
            .AddConnectedDestination(instrument);
      }
    }
  }

  std::string Saved() const {
    std::ifstream stream(prefs.folder / "Ostinet.xml", std::ios::binary);
    return {std::istreambuf_iterator<char>(stream), std::istreambuf_iterator<char>()};
  }

  /// Connections follow the moment of writing; the rest is the studio itself.
  static std::string WithoutConnections(std::string const& saved) {
    static std::regex const kConnection("\\s*<Connection [^>]*/>");
    return std::regex_replace(saved, kConnection, "");
  }

  /// Every object with what its peer holds, in the order of the lists.
  std::vector<std::pair<std::string, Impl::SelfStorageImplImpl::Store>> Tree() const {
    std::vector<std::pair<std::string, Impl::SelfStorageImplImpl::Store>> tree;
    auto const add = [&](std::string const& kind, DeviceObject const& object) {
      auto const* const peer =
          dynamic_cast<Impl::SelfStorageImplImpl const*>(ImplOf(object)->Peer());
      tree.emplace_back(
          kind + " " + object.GetName().string(),
          peer != nullptr ? peer->OwnProperties() : Impl::SelfStorageImplImpl::Store());
    };
    for (int d = 0; d < setup.CountDevices(); ++d) {
      Device const device = setup.GetDevice(d);
      add("device", device);
      for (int e = 0; e < device.CountEntities(); ++e) {
        Entity const entity = device.GetEntity(e);
        add("entity", entity);
        for (int i = 0; i < entity.CountSources(); ++i) {
          add("source", entity.GetSource(i));
        }
        for (int i = 0; i < entity.CountDestinations(); ++i) {
          add("destination", entity.GetDestination(i));
        }
      }
    }
    return tree;
  }

  std::mt19937 random_{1};
};

TEST_F(RandomStudio, SavedAndLoadedTwiceIsTheSame) {
  for (unsigned round = 0; round < 40; ++round) {
    SCOPED_TRACE(round);
    random_.seed(round);
    std::filesystem::remove(prefs.folder / "Ostinet.xml");
    for (SimulatedPort const& port : midi.Ports()) {
      midi.RemovePort(port.name, port.kind);
    }
    DrawPorts();
    SignIn();
    DrawStudio();
    auto const tree = Tree();
    SignOut(true);
    std::string const first = Saved();
    bool const loses = Draw(2) == 0;
    if (loses) {
      midi.RemovePort("Out 1");  // it stays in the studio, offline
    }
    SignIn();
    EXPECT_TRUE(Tree() == tree);
    SignOut(true);
    std::string const second = Saved();
    EXPECT_EQ(WithoutConnections(first) == WithoutConnections(second), !loses);
    SignIn();
    EXPECT_TRUE(Tree() == tree);
    SignOut(true);
    EXPECT_EQ(Saved(), second);
  }
}

}  // namespace
}  // namespace Ostinet::Testing
