// SPDX-License-Identifier: MIT
#pragma once

#include <atomic>
#include <memory>
#include <utility>

#include "platform/system/WindowsTypes.h"
#include "platform/system/simulated/Studio.h"

namespace Ostinet::Impl::Simulated {

/// A COM object of the simulated system: counted, ends with its last reference, keeps the studio
/// alive, and counts among the studio's objects.
///
/// Threads  Any for the count.
template <class Interface>
class ComObject : public Interface {
 public:
  ComObject(ComObject const&) = delete;
  ComObject& operator=(ComObject const&) = delete;

  HRESULT STDMETHODCALLTYPE QueryInterface(REFIID iid, void** object) override {
    if (object == nullptr) return E_POINTER;
    *object = nullptr;
    if (iid != IID_IUnknown && iid != iid_) return E_NOINTERFACE;
    *object = static_cast<Interface*>(this);
    AddRef();
    return S_OK;
  }

  ULONG STDMETHODCALLTYPE AddRef() override {
    return references_.fetch_add(1, std::memory_order_relaxed) + 1;
  }

  ULONG STDMETHODCALLTYPE Release() override {
    // Release, then acquire: what others did with the object happens before its end.
    ULONG const left = references_.fetch_sub(1, std::memory_order_acq_rel) - 1;
    if (left == 0) delete this;
    return left;
  }

 protected:
  ComObject(std::shared_ptr<Studio> studio, ObjectCounts::Interface which, REFIID iid)
      : studio_(std::move(studio)), which_(which), iid_(iid) {
    studio_->Objects().Add(which_, 1);
  }

  virtual ~ComObject() {
    studio_->Objects().Add(which_, -1);
    studio_->Book().Log(Op::kDestroy, 0, {}, &ObjectCounts::NameOf(which_));
  }

  Studio& GetStudio() const { return *studio_; }
  std::shared_ptr<Studio> const& SharedStudio() const { return studio_; }

  /// Counts a call; true when it was told to fail, `result` then being what it gives.
  bool Fails(Op op, HRESULT& result) const {
    long long failure = 0;
    if (!studio_->Book().Fails(op, failure)) return false;
    result = static_cast<HRESULT>(failure);
    return true;
  }

  HRESULT Log(Op op, HRESULT result, CallBook::Arguments arguments = {},
              std::string const* port = nullptr) const {
    studio_->Book().Log(op, result, arguments, port);
    return result;
  }

 private:
  std::shared_ptr<Studio> const studio_;
  ObjectCounts::Interface const which_;
  IID const iid_;
  std::atomic<ULONG> references_{1};
};

/// The studio's clock, as the master clock or ahead of it by a port's latency.
class StudioClock final : public ComObject<IReferenceClock> {
 public:
  /// `ahead` in units of 100 ns.
  StudioClock(std::shared_ptr<Studio> studio, std::int64_t ahead)
      : ComObject(std::move(studio), ObjectCounts::kClock, IID_IReferenceClock), ahead_(ahead) {}

  HRESULT STDMETHODCALLTYPE GetTime(REFERENCE_TIME* time) override {
    HRESULT result = S_OK;
    if (Fails(Op::kGetTime, result)) return result;
    if (time == nullptr) return E_POINTER;
    *time = GetStudio().Clock().ReadMaster() + ahead_;
    return Log(Op::kGetTime, S_OK, {*time});
  }
  HRESULT STDMETHODCALLTYPE AdviseTime(REFERENCE_TIME, REFERENCE_TIME, HANDLE, DWORD*) override {
    return E_NOTIMPL;
  }
  HRESULT STDMETHODCALLTYPE AdvisePeriodic(REFERENCE_TIME, REFERENCE_TIME, HANDLE,
                                           DWORD*) override {
    return E_NOTIMPL;
  }
  HRESULT STDMETHODCALLTYPE Unadvise(DWORD) override { return E_NOTIMPL; }

 private:
  std::int64_t const ahead_;
};

}  // namespace Ostinet::Impl::Simulated
