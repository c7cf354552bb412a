// SPDX-License-Identifier: MIT
#pragma once

#include <utility>

#include "platform/system/simulated/ComObject.h"

namespace Ostinet::Impl::Simulated {

/// One instrument of the default collection.
class CollectionInstrument final : public ComObject<IDirectMusicInstrument> {
 public:
  CollectionInstrument(std::shared_ptr<Studio> studio, DWORD patch)
      : ComObject(std::move(studio), ObjectCounts::kInstrument, IID_IDirectMusicInstrument),
        patch_(patch) {}

  HRESULT STDMETHODCALLTYPE GetPatch(DWORD* patch) override {
    if (patch == nullptr) return E_POINTER;
    *patch = patch_;
    return S_OK;
  }
  HRESULT STDMETHODCALLTYPE SetPatch(DWORD patch) override {
    patch_ = patch;
    return S_OK;
  }

 private:
  DWORD patch_;
};

/// An instrument on a port, until it is unloaded.
class DownloadedInstrument final : public ComObject<IDirectMusicDownloadedInstrument> {
 public:
  DownloadedInstrument(std::shared_ptr<Studio> studio, PortPtr port)
      : ComObject(std::move(studio), ObjectCounts::kDownloadedInstrument,
                  IID_IDirectMusicDownloadedInstrument),
        port_(std::move(port)) {}

  /// Both with the studio's mutex held.
  bool IsLoadedOn(Port const& port) const { return port_.get() == &port; }
  void UnloadLocked() {
    --port_->downloaded;
    port_ = nullptr;
  }

 private:
  PortPtr port_;
};

}  // namespace Ostinet::Impl::Simulated
