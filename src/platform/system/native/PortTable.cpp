// SPDX-License-Identifier: MIT
//
// The hard part is to keep names and numbers still. A port that returns under its id takes its old
// number, and its old name unless another port bears that by now. A new port takes the number of
// one that is away under the same name (a replugged interface whose address changed), else a new
// one. Of two present ports that would have one name, the later gets " 2".
#include "platform/system/native/PortTable.h"

#include <algorithm>
#include <set>
#include <utility>

#include "platform/system/native/PortNames.h"

namespace Ostinet::Impl {
namespace {

struct Listed {
  std::shared_ptr<MidiService> service;
  ServicePort port;
};

std::vector<Listed> ListAll(std::vector<std::shared_ptr<MidiService>> const& services,
                            PortDirection direction) {
  std::vector<Listed> all;
  for (auto const& service : services) {
    if (!service->IsAlive()) continue;
    for (ServicePort& port : service->List(direction)) all.push_back({service, std::move(port)});
  }
  return all;
}

bool IsSame(TablePort const& known, Listed const& listed) {
  return known.service == listed.service && known.id == listed.port.id;
}

bool LooksTheSame(TablePort const& a, TablePort const& b) {
  return a.present == b.present && a.name == b.name;
}

void TakeNewPort(std::vector<TablePort>& ports, Listed const& listed,
                 std::set<std::u16string>& taken) {
  std::u16string const name = MakePortNameUnique(FitPortName(listed.port.name), taken);
  taken.insert(name);
  auto const away = std::find_if(ports.begin(), ports.end(), [&](TablePort const& known) {
    return !known.present && known.name == name;
  });
  TablePort entry{listed.service, listed.port.id, name, true};
  if (away == ports.end()) {
    ports.push_back(std::move(entry));
  } else {
    *away = std::move(entry);
  }
}

}  // namespace

PortTable::PortTable(std::vector<std::shared_ptr<MidiService>> services)
    : services_(std::move(services)) {}

unsigned PortTable::Refresh() {
  std::scoped_lock refreshing(refreshing_);
  bool const inputs = RefreshDirection(PortDirection::kInput);
  bool const outputs = RefreshDirection(PortDirection::kOutput);
  if (inputs || outputs) ++changes_;
  return changes_;
}

bool PortTable::RefreshDirection(PortDirection direction) {
  std::vector<Listed> listed = ListAll(services_, direction);
  std::scoped_lock lock(mutex_);
  Ports& ports = PortsOf(direction);
  Ports const before = ports;
  for (TablePort& known : ports) known.present = false;

  // First those that stay, then those that return, then the new ones: a name is lost to nobody who
  // came later.
  std::set<std::u16string> taken;
  for (bool staying : {true, false}) {
    for (std::size_t i = 0; i < ports.size(); ++i) {
      if (before[i].present != staying || taken.contains(ports[i].name)) continue;
      auto const match = std::find_if(listed.begin(), listed.end(),
                                      [&](Listed const& l) { return IsSame(ports[i], l); });
      if (match == listed.end()) continue;
      ports[i].present = true;
      taken.insert(ports[i].name);
      listed.erase(match);
    }
  }
  for (Listed const& port : listed) TakeNewPort(ports, port, taken);
  return !std::equal(before.begin(), before.end(), ports.begin(), ports.end(), LooksTheSame);
}

unsigned PortTable::Count() const {
  std::scoped_lock lock(mutex_);
  return static_cast<unsigned>(std::max(ports_[0].size(), ports_[1].size()));
}

std::optional<TablePort> PortTable::Find(PortDirection direction, std::uintptr_t number) const {
  std::scoped_lock lock(mutex_);
  Ports const& ports = PortsOf(direction);
  if (number >= ports.size() || !ports[number].present) return std::nullopt;
  return ports[number];
}

std::vector<TablePort> PortTable::Present(PortDirection direction) const {
  std::scoped_lock lock(mutex_);
  std::vector<TablePort> present;
  std::copy_if(PortsOf(direction).begin(), PortsOf(direction).end(), std::back_inserter(present),
               [](TablePort const& port) { return port.present; });
  return present;
}

}  // namespace Ostinet::Impl
