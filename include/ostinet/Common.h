// SPDX-License-Identifier: MIT
#pragma once

#include <atomic>
#include <functional>

#include "ostinet/Export.h"
#include "ostinet/core/UString.h"

namespace Ostinet {

namespace Impl {
class ObjectImpl;
class DeviceObjectImpl;
class DeviceImpl;
class EntityImpl;
class EndpointImpl;
class DestinationImpl;
class DestModeImpl;
class DestNameSetImpl;
class PatchBankImpl;
class PatchImpl;
class DeviceTypeInfoImpl;
class AutodetectRequestImpl;
class AutodetectResponseImpl;
class SysexImpl;
class ValueListImpl;
class ImplImpl;
class NamesCatalogImpl;
class Sender;
class WinMIDIDevicesListener;
}  // namespace Impl

/// Mix-in base that holds one reference count, starting at 0. When a reference is dropped and the
/// count reaches 0, the object deletes itself.
///
/// Threads      [any thread] The count is atomic.
template <class T>
class RCObjectMT {
 public:
  RCObjectMT(RCObjectMT const&) = delete;
  RCObjectMT& operator=(RCObjectMT const&) = delete;

  /// Adds one reference.
  void AddReference() const { count_.fetch_add(1, std::memory_order_relaxed); }

  /// Drops one reference and deletes the object with the last one.
  void RemoveReference() const {
    // Release, then acquire: whatever other threads did with the object happens before its end.
    if (count_.fetch_sub(1, std::memory_order_acq_rel) == 1) {
      delete this;
    }
  }

 protected:
  RCObjectMT() = default;
  virtual ~RCObjectMT() = default;

 private:
  mutable std::atomic<int> count_{0};
};

/// Intrusive pointer to a counted object. The members are defined out of class, none of them
/// inline, so that a pointer to one of the library's own classes works in a host that sees only
/// their names: a DLL exports no inline members of a template.
///
/// Threads      One pointer belongs to one thread at a time; the object behind it is counted
///              atomically, so pointers to one object may live on any threads.
template <class T>
class RCPtrMT {
 public:
  RCPtrMT();
  RCPtrMT(T* pointer);
  RCPtrMT(RCPtrMT const& other);
  template <class U>
  RCPtrMT(RCPtrMT<U> const& other) : RCPtrMT(static_cast<T*>(other.get())) {}
  ~RCPtrMT();

  RCPtrMT& operator=(RCPtrMT const& other);
  /// Shares `pointer`. The old object is released last, so a pointer into it may be assigned.
  RCPtrMT& operator=(T* pointer);

  T* get() const;
  T* operator->() const;
  T& operator*() const;
  explicit operator bool() const;

  bool operator==(RCPtrMT const& other) const;
  bool operator!=(RCPtrMT const& other) const;
  bool operator<(RCPtrMT const& other) const;

 private:
  T* pointer_;
};

template <class T>
RCPtrMT<T>::RCPtrMT() : pointer_(nullptr) {}

template <class T>
RCPtrMT<T>::RCPtrMT(T* pointer) : pointer_(pointer) {
  if (pointer_ != nullptr) {
    pointer_->AddReference();
  }
}

template <class T>
RCPtrMT<T>::RCPtrMT(RCPtrMT const& other) : RCPtrMT(other.pointer_) {}

template <class T>
RCPtrMT<T>::~RCPtrMT() {
  if (pointer_ != nullptr) {
    pointer_->RemoveReference();
  }
}

template <class T>
RCPtrMT<T>& RCPtrMT<T>::operator=(RCPtrMT const& other) {
  return this == &other ? *this : *this = other.pointer_;
}

template <class T>
RCPtrMT<T>& RCPtrMT<T>::operator=(T* pointer) {
  if (pointer != pointer_) {
    T* const old = pointer_;
    if (pointer != nullptr) {
      pointer->AddReference();
    }
    pointer_ = pointer;
    if (old != nullptr) {
      old->RemoveReference();
    }
  }
  return *this;
}

template <class T>
T* RCPtrMT<T>::get() const {
  return pointer_;
}

template <class T>
T* RCPtrMT<T>::operator->() const {
  return pointer_;
}

template <class T>
T& RCPtrMT<T>::operator*() const {
  return *pointer_;
}

template <class T>
RCPtrMT<T>::operator bool() const {
  return pointer_ != nullptr;
}

template <class T>
bool RCPtrMT<T>::operator==(RCPtrMT const& other) const {
  return pointer_ == other.pointer_;
}

template <class T>
bool RCPtrMT<T>::operator!=(RCPtrMT const& other) const {
  return pointer_ != other.pointer_;
}

template <class T>
bool RCPtrMT<T>::operator<(RCPtrMT const& other) const {
  return std::less<T*>()(pointer_, other.pointer_);
}

// Instantiated once, in the library, where these classes are complete.
extern template class OSTINET_EXPORT RCPtrMT<Impl::ObjectImpl>;
extern template class OSTINET_EXPORT RCPtrMT<Impl::DeviceObjectImpl>;
extern template class OSTINET_EXPORT RCPtrMT<Impl::DeviceImpl>;
extern template class OSTINET_EXPORT RCPtrMT<Impl::EntityImpl>;
extern template class OSTINET_EXPORT RCPtrMT<Impl::EndpointImpl>;
extern template class OSTINET_EXPORT RCPtrMT<Impl::DestinationImpl>;
extern template class OSTINET_EXPORT RCPtrMT<Impl::DeviceTypeInfoImpl>;
extern template class OSTINET_EXPORT RCPtrMT<Impl::AutodetectRequestImpl>;
extern template class OSTINET_EXPORT RCPtrMT<Impl::AutodetectResponseImpl>;
extern template class OSTINET_EXPORT RCPtrMT<Impl::SysexImpl>;
extern template class OSTINET_EXPORT RCPtrMT<Impl::DestModeImpl>;
extern template class OSTINET_EXPORT RCPtrMT<Impl::DestNameSetImpl>;
extern template class OSTINET_EXPORT RCPtrMT<Impl::PatchBankImpl>;
extern template class OSTINET_EXPORT RCPtrMT<Impl::PatchImpl>;
extern template class OSTINET_EXPORT RCPtrMT<Impl::ValueListImpl>;

/// Facts about the MIDI backend that is in use.
///
/// Ownership    Owned by Setup; read it through Setup::GetProperties.
/// Threads      [any thread] It has no state.
class OSTINET_EXPORT Properties {
 public:
  /// Which backend a thing belongs to. The values are stored in persistent references.
  enum Implementation : int {
    kNoImplementation = 0,          ///< none: a null handle, or a reference made from a bare name
    kOlderImplementation = 2,       ///< the older MIDI system that references are translated from
    kPlatformImplementation = 3,    ///< the ports of the machine
    kPluginHostImplementation = 4,  ///< destinations of the host's plug-in engine
  };
  /// What came of starting the configuration utility.
  enum RunConfigResult : int {
    kNoConfigUtility = 3,  ///< there is no utility to run
  };

  virtual ~Properties();
  /// kPlatformImplementation.
  virtual Implementation GetImplementation() const;
  /// "WinMIDI".
  virtual UString GetImplementationName() const;
  /// 0.
  virtual unsigned int GetImplementationVersion() const;
  /// False: there is no program that configures this backend.
  virtual bool ConfigUtilityExists() const;
  /// "No MIDI Utility".
  virtual UString GetConfigUtilityName() const;
  /// kNoConfigUtility, at once.
  virtual RunConfigResult RunConfigUtility() const;
};

}  // namespace Ostinet
