// SPDX-License-Identifier: MIT
#include "ostinet/SysexRef.h"

#include <algorithm>
#include <functional>
#include <limits>

#include "datapath/SysexImpl.h"

namespace Ostinet {
namespace {

RCPtrMT<Impl::SysexImpl> MakeMessage(size_t size) {
  return size == 0 ? RCPtrMT<Impl::SysexImpl>()
                   : RCPtrMT<Impl::SysexImpl>(new Impl::SysexImpl(size));
}

RCPtrMT<Impl::SysexImpl> MakeMessage(unsigned char const* bytes, size_t size) {
  RCPtrMT<Impl::SysexImpl> const impl = MakeMessage(size);
  if (impl.get() != nullptr && bytes != nullptr) {
    std::copy(bytes, bytes + size, impl->begin());
  }
  return impl;
}

// Whether `position` points at a byte of the message or at its end.
bool IsWithin(SysexRefBase const& ref, unsigned char const* position) {
  std::less_equal<unsigned char const*> const notAfter;
  return !ref.IsNull() && notAfter(ref.begin(), position) && notAfter(position, ref.end());
}

size_t OffsetOf(SysexRefBase const& ref, unsigned char const* position) {
  return static_cast<size_t>(position - ref.begin());
}

}  // namespace

SysexRefBase const SysexRefBase::kNullSysexRef;

SysexRefBase::SysexRefBase() = default;
SysexRefBase::SysexRefBase(size_t size) : impl_(MakeMessage(size)) {}
SysexRefBase::SysexRefBase(unsigned char const* bytes, size_t size)
    : impl_(MakeMessage(bytes, size)) {}
SysexRefBase::SysexRefBase(SysexRefBase const& other) = default;
SysexRefBase::SysexRefBase(RCPtrMT<Impl::SysexImpl> const& impl) : impl_(impl) {}
SysexRefBase::~SysexRefBase() = default;

SysexRefBase& SysexRefBase::operator=(SysexRefBase const& other) = default;
void SysexRefBase::AssignTo(SysexRefBase const& other) { impl_ = other.impl_; }
void SysexRefBase::AssignTo(RCPtrMT<Impl::SysexImpl> const& impl) { impl_ = impl; }

unsigned char* SysexRefBase::begin() const { return IsNull() ? nullptr : impl_->begin(); }
unsigned char* SysexRefBase::end() const { return IsNull() ? nullptr : impl_->end(); }
size_t SysexRefBase::size() const { return IsNull() ? 0 : impl_->Size(); }
bool SysexRefBase::empty() const { return size() == 0; }
bool SysexRefBase::IsNull() const { return impl_.get() == nullptr; }
size_t SysexRefBase::max_size() const { return std::numeric_limits<size_t>::max(); }

std::reverse_iterator<unsigned char*> SysexRefBase::rbegin() const {
  return std::reverse_iterator<unsigned char*>(end());
}

std::reverse_iterator<unsigned char*> SysexRefBase::rend() const {
  return std::reverse_iterator<unsigned char*>(begin());
}

unsigned char& SysexRefBase::operator[](size_t index) const { return impl_->begin()[index]; }

bool SysexRefBase::operator==(SysexRefBase const& other) const { return impl_ == other.impl_; }
bool SysexRefBase::operator!=(SysexRefBase const& other) const { return impl_ != other.impl_; }

SysexRef::SysexRef() = default;
SysexRef::SysexRef(size_t size) : SysexRefBase(size) {}
SysexRef::SysexRef(unsigned char const* bytes, size_t size) : SysexRefBase(bytes, size) {}
SysexRef::SysexRef(SysexRef const& other) = default;
SysexRef::SysexRef(SysexRefBase const& other) : SysexRefBase(other) {}
SysexRef::SysexRef(RCPtrMT<Impl::SysexImpl> const& impl) : SysexRefBase(impl) {}
SysexRef::SysexRef(UnsafeSysexRef const& other) { *this = other; }

SysexRef& SysexRef::operator=(SysexRef const& other) = default;

SysexRef& SysexRef::operator=(UnsafeSysexRef const& other) {
  impl_ = static_cast<Impl::SysexImpl*>(other._get_as_void_pointer());
  return *this;
}

SysexRef SysexRef::Copy() const { return SysexRef(begin(), size()); }
bool SysexRef::IsSending() const { return false; }

SysexEditRef::SysexEditRef() = default;
SysexEditRef::SysexEditRef(size_t size) : SysexRefBase(size) {}
SysexEditRef::SysexEditRef(unsigned char const* bytes, size_t size) : SysexRefBase(bytes, size) {}

void SysexEditRef::Reset(size_t size) { impl_ = MakeMessage(size); }

void SysexEditRef::CopyFrom(SysexRefBase const& other) {
  impl_ = MakeMessage(other.begin(), other.size());
}

SysexRef SysexEditRef::CopyToSysexRef() const { return SysexRef(begin(), size()); }

void SysexEditRef::ReleaseTo(SysexRefBase& target) {
  target.AssignTo(*this);
  impl_ = nullptr;
}

void SysexEditRef::resize(size_t size) const {
  if (!IsNull()) {
    impl_->Resize(size);
  }
}

unsigned char* SysexEditRef::insert(unsigned char* position, unsigned char byte) const {
  if (!IsWithin(*this, position)) {
    return end();
  }
  size_t const offset = OffsetOf(*this, position);
  impl_->Insert(offset, 1, byte);
  return begin() + offset;
}

void SysexEditRef::insert(unsigned char* position, size_t count, unsigned char byte) const {
  if (IsWithin(*this, position)) {
    impl_->Insert(OffsetOf(*this, position), count, byte);
  }
}

unsigned char* SysexEditRef::erase(unsigned char* position) const {
  if (!IsWithin(*this, position) || position == end()) {
    return end();
  }
  return erase(position, position + 1);
}

unsigned char* SysexEditRef::erase(unsigned char* first, unsigned char* last) const {
  if (!IsWithin(*this, first) || !IsWithin(*this, last) || last < first) {
    return end();
  }
  impl_->Erase(OffsetOf(*this, first), static_cast<size_t>(last - first));
  return first;
}

UnsafeSysexRef::UnsafeSysexRef() : impl_(nullptr) {}

void UnsafeSysexRef::SetTo(SysexRef const& ref) {
  impl_ = ref.GetImpl().get();
  if (impl_ != nullptr) {
    impl_->AddReference();
  }
}

void UnsafeSysexRef::Release() {
  if (impl_ != nullptr) {
    impl_->RemoveReference();
    impl_ = nullptr;
  }
}

void* UnsafeSysexRef::_get_as_void_pointer() const { return impl_; }

void UnsafeSysexRef::_set_from_void_pointer(void* pointer) {
  impl_ = static_cast<Impl::SysexImpl*>(pointer);
}

bool UnsafeSysexRef::operator==(UnsafeSysexRef const& other) const { return impl_ == other.impl_; }

}  // namespace Ostinet
