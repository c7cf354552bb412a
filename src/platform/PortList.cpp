// SPDX-License-Identifier: MIT

#include "platform/PortList.h"

#include <cstddef>
#include <unordered_map>

#include "platform/system/WideText.h"

namespace Ostinet::Impl {

namespace {

// A driver that answers for ever must not hang the enumeration.
constexpr DWORD kMostPorts = 65536;

bool IsMicrosoft(UString const& name) {
  static UString const kMicrosoft("Microsoft");
  return name.find(kMicrosoft) != static_cast<std::size_t>(-1);
}

/// The DirectMusic ports of one direction, which are taken out by name as WinMM claims them.
class DMusPorts {
 public:
  struct Entry {
    DMUS_PORTCAPS caps;
    DMusPortName port;
    bool isTaken = false;
  };

  void Add(DMUS_PORTCAPS const& caps) {
    entries_.push_back({caps, NameOfPort(caps)});
    byName_[entries_.back().port.name].push_back(entries_.size() - 1);
  }

  /// Takes out every port of that name and gives the first, or null. Further ports of the name
  /// are dropped: WinMM's device stands for all of them.
  Entry const* Take(UString const& name) {
    auto const found = byName_.find(name);
    if (found == byName_.end()) {
      return nullptr;
    }
    std::vector<std::size_t> const indexes = std::move(found->second);
    byName_.erase(found);
    for (std::size_t const index : indexes) {
      entries_[index].isTaken = true;
    }
    return &entries_[indexes.front()];
  }

  template <class Port>
  void AppendRest(PortList& list) const {
    for (Entry const& entry : entries_) {
      if (!entry.isTaken && !IsMicrosoft(entry.port.name)) {
        list.push_back(Port{entry.caps});
      }
    }
  }

 private:
  std::vector<Entry> entries_;
  std::unordered_map<UString, std::vector<std::size_t>> byName_;
};

void ListDMusPorts(IDirectMusic& directMusic, DMusPorts& inputs, DMusPorts& outputs) {
  for (DWORD index = 0; index < kMostPorts; ++index) {
    DMUS_PORTCAPS caps{};
    caps.dwSize = sizeof caps;
    if (directMusic.EnumPort(index, &caps) != S_OK) {
      return;
    }
    if (caps.dwClass == DMUS_PC_INPUTCLASS) {
      inputs.Add(caps);
    } else if (caps.dwClass == DMUS_PC_OUTPUTCLASS) {
      outputs.Add(caps);
    }
  }
}

template <class DMusPort, class LegacyPort, class Caps>
void AppendShared(DMusPorts& ports, Caps const& caps, UINT device, PortList& list) {
  UString const name = TextOf(caps.szPname);
  DMusPorts::Entry const* const entry = ports.Take(name);
  if (entry == nullptr || IsMicrosoft(name)) {
    return;
  }
  if (entry->port.isEmulated) {
    list.push_back(LegacyPort{caps, device});
  } else {
    list.push_back(DMusPort{entry->caps});
  }
}

}  // namespace

DMusPortName NameOfPort(DMUS_PORTCAPS const& caps) {
  static UString const kSuffix(" [Emulated]");
  UString name = TextOf(caps.wszDescription);
  if (caps.dwType != DMUS_PORT_WINMM_DRIVER || name.length() < kSuffix.length()) {
    return {name, false};
  }
  auto const start = name.length() - kSuffix.length();
  if (!(name.substr(start) == kSuffix)) {
    return {name, false};
  }
  return {name.substr(0, start), true};
}

UString NameOfPort(PortInfo const& port) {
  struct Namer : boost::static_visitor<UString> {
    UString operator()(DMusInput const& input) const { return NameOfPort(input.caps).name; }
    UString operator()(DMusOutput const& output) const { return NameOfPort(output.caps).name; }
    UString operator()(LegacyInput const& input) const { return TextOf(input.caps.szPname); }
    UString operator()(LegacyOutput const& output) const { return TextOf(output.caps.szPname); }
  };
  return boost::apply_visitor(Namer(), port);
}

bool IsSource(PortInfo const& port) {
  struct Test : boost::static_visitor<bool> {
    bool operator()(DMusInput const&) const { return true; }
    bool operator()(LegacyInput const&) const { return true; }
    bool operator()(DMusOutput const&) const { return false; }
    bool operator()(LegacyOutput const&) const { return false; }
  };
  return boost::apply_visitor(Test(), port);
}

PortList EnumeratePorts(System& system, IDirectMusic& directMusic) {
  DMusPorts inputs, outputs;
  ListDMusPorts(directMusic, inputs, outputs);

  PortList list;
  UINT const outputCount = system.midiOutGetNumDevs();
  for (UINT device = 0; device < outputCount; ++device) {
    MIDIOUTCAPSW caps{};
    if (system.midiOutGetDevCapsW(device, &caps, sizeof caps) == MMSYSERR_NOERROR) {
      AppendShared<DMusOutput, LegacyOutput>(outputs, caps, device, list);
    }
  }
  // The count of outputs bounds the inputs too. Studios were saved under that rule: an input
  // beyond it is found through DirectMusic alone, and its stored port must stay of that kind.
  system.midiInGetNumDevs();
  for (UINT device = 0; device < outputCount; ++device) {
    MIDIINCAPSW caps{};
    if (system.midiInGetDevCapsW(device, &caps, sizeof caps) == MMSYSERR_NOERROR) {
      AppendShared<DMusInput, LegacyInput>(inputs, caps, device, list);
    }
  }
  outputs.AppendRest<DMusOutput>(list);
  inputs.AppendRest<DMusInput>(list);
  return list;
}

}  // namespace Ostinet::Impl
