// SPDX-License-Identifier: MIT

#include "platform/ports/WinDMusMIDIOutPort.h"

#include "datapath/SysexImpl.h"
#include "model/PropertyKeys.h"
#include "ostinet/core/Error.h"
#include "platform/ports/WinSender.h"

namespace Ostinet::Impl {

namespace {

// A collection that lists instruments for ever must not hang the opening.
constexpr DWORD kMostInstruments = 65536;
constexpr DWORD kNameUnits = 64;

ComPtr<IDirectMusicCollection> DefaultCollection(IDirectMusicLoader& loader) {
  DMUS_OBJECTDESC description{};
  description.dwSize = sizeof description;
  description.dwValidData = DMUS_OBJ_OBJECT | DMUS_OBJ_CLASS;
  description.guidClass = CLSID_DirectMusicCollection;
  description.guidObject = GUID_DefaultGMCollection;
  void* collection = nullptr;
  ComPtr<IDirectMusicCollection> result;
  if (loader.GetObject(&description, IID_IDirectMusicCollection, &collection) == S_OK) {
    *result.Receive() = static_cast<IDirectMusicCollection*>(collection);
  }
  return result;
}

}  // namespace

WinDMusMIDIOutPort::~WinDMusMIDIOutPort() {
  instruments_.clear();  // before the port goes
}

void WinDMusMIDIOutPort::Open(DMUS_PORTCAPS const& caps) {
  WinDMusMIDIPort::Open(caps);
  SetInt(Keys::kScheduleAheadMuSec, MeasureLatency());
  if ((caps.dwFlags & DMUS_PC_DLS) != 0) {
    DownloadDefaultSet();
  }
}

/// How far ahead the port wants its events, in microseconds rounded to whole milliseconds.
int WinDMusMIDIOutPort::MeasureLatency() const {
  ComPtr<IReferenceClock> clock;
  if (Port()->GetLatencyClock(clock.Receive()) != S_OK || !clock) {
    return 0;
  }
  unsigned long long now = 0;
  try {
    now = CurrentMIDITime().Value();
  } catch (VantorError const&) {
    return 0;
  }
  REFERENCE_TIME time = 0;
  if (clock->GetTime(&time) != S_OK || static_cast<unsigned long long>(time) <= now) {
    return 0;
  }
  unsigned long long const nanos =
      MIDITimeToNanoseconds(Clocks(static_cast<unsigned long long>(time) - now)).Value();
  return static_cast<int>((nanos / 1000 + 500) / 1000 * 1000);
}

void WinDMusMIDIOutPort::DownloadDefaultSet() {
  ComPtr<IDirectMusicCollection> const collection =
      DefaultCollection(*GetSession()->Loader().get());
  if (!collection) {
    return;
  }
  DWORD patch = 0;
  WCHAR name[kNameUnits];
  for (DWORD index = 0; index < kMostInstruments; ++index) {
    if (collection->EnumInstrument(index, &patch, name, kNameUnits) != S_OK) {
      return;
    }
    ComPtr<IDirectMusicInstrument> instrument;
    ComPtr<IDirectMusicDownloadedInstrument> downloaded;
    if (collection->GetInstrument(patch, instrument.Receive()) == S_OK &&
        Port()->DownloadInstrument(instrument.get(), downloaded.Receive(), nullptr, 0) == S_OK) {
      instruments_.push_back(std::move(downloaded));
    }
  }
}

void WinDMusMIDIOutPort::Deactivate() {
  if (Port() != nullptr) {
    Line()->isOpen = false;
    for (auto const& instrument : instruments_) {
      Port()->UnloadInstrument(instrument.get());
    }
    instruments_.clear();
  }
  ClearOwner();
}

void WinDMusMIDIOutPort::SendSysex(TimeStamp stamp, RCPtrMT<SysexImpl> const& sysex) {
  if (Port() == nullptr || !sysex || sysex->Size() == 0) {
    return;
  }
  std::unique_ptr<Sender> const sender = MakeSender(Owner());
  if (sender != nullptr && sender->CanSend()) {
    sender->Send({sysex->begin(), sysex->Size(), stamp});
    sender->Flush();
  }
}

}  // namespace Ostinet::Impl
