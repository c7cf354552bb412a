// SPDX-License-Identifier: MIT
#pragma once

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <filesystem>
#include <functional>
#include <map>
#include <string>
#include <utility>
#include <vector>

#include "ostinet/Setup.h"
#include "support/Printers.h"
#include "support/TemporaryPath.h"

namespace Ostinet::Testing {

/// Notes what it hears.
class RecordingListener : public SetupListener {
 public:
  using Patch = std::pair<Destination, unsigned short>;

  void SetupChanged() override {
    ++setupChanges;
    if (onSetupChanged) {
      onSetupChanged();
    }
  }
  void CurrentPatchChanged(Destination destination, unsigned short channels) override {
    patches.emplace_back(destination, channels);
    if (onPatchChanged) {
      onPatchChanged();
    }
  }
  void DestinationNamesChanged(Destination destination, unsigned short channels) override {
    names.emplace_back(destination, channels);
  }

  int setupChanges = 0;
  std::vector<Patch> patches;
  std::vector<Patch> names;
  std::function<void()> onSetupChanged;
  std::function<void()> onPatchChanged;
};

/// Notes what it gets.
class RecordingReceiver : public Receiver {
 public:
  bool WantsPacket(DataPacket const&, Source const&) override { return wantsPackets; }
  void HandlePacket(DataPacket const& packet, Source const& source) override {
    packets.emplace_back(source,
                         std::vector<unsigned char>(packet.data, packet.data + packet.length));
  }

  bool wantsPackets = true;
  std::vector<std::pair<Source, std::vector<unsigned char>>> packets;
};

/// `path` with the separators that the system writes.
UString SystemPath(UString const& path);

/// Keeps blocks in memory, and files in a folder of its own that goes with it.
class MemoryPrefs : public PrefsHandler {
  TemporaryPath temporary_;

 public:
  void Save(int id, std::vector<unsigned char> const& bytes) override { blocks[id] = bytes; }
  void Load(int id, std::vector<unsigned char>& bytes) override {
    loads.push_back(id);
    bytes = blocks.count(id) != 0 ? blocks[id] : std::vector<unsigned char>();
  }
  void GetFolder(Folder& out) override { out = Folder(FileSpecification(FolderPath())); }

  UString FolderPath() const { return UString(folder.string().c_str()); }
  /// Makes a file and gives its full path.
  UString MakeFile(std::string const& name, std::string const& content = "");

  std::map<int, std::vector<unsigned char>> blocks;
  std::vector<int> loads;
  std::filesystem::path folder = temporary_.Path();
};

}  // namespace Ostinet::Testing
