// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <iterator>

#include "ostinet/Common.h"

namespace Ostinet {
class SysexRefBase {
 public:
  static SysexRefBase const kNullSysexRef;
  SysexRefBase();
  explicit SysexRefBase(size_t);
  SysexRefBase(unsigned char const*, size_t);
  SysexRefBase(SysexRefBase const&);
  explicit SysexRefBase(RCPtrMT<Impl::SysexImpl> const&);
  virtual ~SysexRefBase();
  SysexRefBase& operator=(SysexRefBase const&);
  void AssignTo(SysexRefBase const&);
  void AssignTo(RCPtrMT<Impl::SysexImpl> const&);
  unsigned char* begin() const;
  unsigned char* end() const;
  size_t size() const;
  bool empty() const;
  bool IsNull() const;
  size_t max_size() const;
  std::reverse_iterator<unsigned char*> rbegin() const;
  std::reverse_iterator<unsigned char*> rend() const;
  unsigned char& operator[](size_t) const;
  bool operator==(SysexRefBase const&) const;
  bool operator!=(SysexRefBase const&) const;
};
class UnsafeSysexRef;
class SysexRef : public SysexRefBase {
 public:
  SysexRef();
  explicit SysexRef(size_t);
  SysexRef(unsigned char const*, size_t);
  SysexRef(SysexRefBase const&);
  explicit SysexRef(RCPtrMT<Impl::SysexImpl> const&);
  SysexRef(UnsafeSysexRef const&);
  SysexRef& operator=(SysexRef const&);
  SysexRef& operator=(UnsafeSysexRef const&);
  SysexRef Copy() const;
  bool IsSending() const;
};
class SysexEditRef : public SysexRefBase {
 public:
  SysexEditRef();
  explicit SysexEditRef(size_t);
  SysexEditRef(unsigned char const*, size_t);
  void Reset(size_t);
  void CopyFrom(SysexRefBase const&);
  SysexRef CopyToSysexRef() const;
  void ReleaseTo(SysexRefBase&);
  void resize(size_t) const;
  unsigned char* insert(unsigned char* position, unsigned char) const;
  void insert(unsigned char* position, size_t count, unsigned char) const;
  unsigned char* erase(unsigned char* position) const;
  unsigned char* erase(unsigned char* first, unsigned char* last) const;
};
class UnsafeSysexRef {
 public:
  UnsafeSysexRef();
  void SetTo(SysexRef const&);
  void Release();
  void* _get_as_void_pointer() const;
  void _set_from_void_pointer(void*);
  bool operator==(UnsafeSysexRef const&) const;
};
}  // namespace Ostinet
