// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include "api/Link.h"
#include "ostinet/SysexRef.h"

namespace Ostinet::Testing {
namespace {

TEST(Declarations, OfSysexAreComplete) {
  Link<Mutable<SysexRefBase, SysexRefBase&, SysexRefBase const&>>(&SysexRefBase::operator=);
  Link<Mutable<SysexRefBase, void, SysexRefBase const&>>(&SysexRefBase::AssignTo);
  Link<Mutable<SysexRefBase, void, RCPtrMT<Impl::SysexImpl> const&>>(&SysexRefBase::AssignTo);
  Link<Const<SysexRefBase, unsigned char*>>(&SysexRefBase::begin);
  Link<Const<SysexRefBase, unsigned char*>>(&SysexRefBase::end);
  Link<Const<SysexRefBase, size_t>>(&SysexRefBase::size);
  Link<Const<SysexRefBase, bool>>(&SysexRefBase::empty);
  Link<Const<SysexRefBase, bool>>(&SysexRefBase::IsNull);
  Link<Const<SysexRefBase, size_t>>(&SysexRefBase::max_size);
  Link<Const<SysexRefBase, std::reverse_iterator<unsigned char*>>>(&SysexRefBase::rbegin);
  Link<Const<SysexRefBase, std::reverse_iterator<unsigned char*>>>(&SysexRefBase::rend);
  Link<Const<SysexRefBase, unsigned char&, size_t>>(&SysexRefBase::operator[]);
  Link<Const<SysexRefBase, bool, SysexRefBase const&>>(&SysexRefBase::operator==);
  Link<Const<SysexRefBase, bool, SysexRefBase const&>>(&SysexRefBase::operator!=);

  Link<Mutable<SysexRef, SysexRef&, SysexRef const&>>(&SysexRef::operator=);
  Link<Mutable<SysexRef, SysexRef&, UnsafeSysexRef const&>>(&SysexRef::operator=);
  Link<Const<SysexRef, SysexRef>>(&SysexRef::Copy);
  Link<Const<SysexRef, bool>>(&SysexRef::IsSending);

  Link<Mutable<SysexEditRef, void, size_t>>(&SysexEditRef::Reset);
  Link<Mutable<SysexEditRef, void, SysexRefBase const&>>(&SysexEditRef::CopyFrom);
  Link<Const<SysexEditRef, SysexRef>>(&SysexEditRef::CopyToSysexRef);
  Link<Mutable<SysexEditRef, void, SysexRefBase&>>(&SysexEditRef::ReleaseTo);
  Link<Const<SysexEditRef, void, size_t>>(&SysexEditRef::resize);
  Link<Const<SysexEditRef, unsigned char*, unsigned char*, unsigned char>>(&SysexEditRef::insert);
  Link<Const<SysexEditRef, void, unsigned char*, size_t, unsigned char>>(&SysexEditRef::insert);
  Link<Const<SysexEditRef, unsigned char*, unsigned char*>>(&SysexEditRef::erase);
  Link<Const<SysexEditRef, unsigned char*, unsigned char*, unsigned char*>>(&SysexEditRef::erase);

  Link<Mutable<UnsafeSysexRef, void, SysexRef const&>>(&UnsafeSysexRef::SetTo);
  Link<Mutable<UnsafeSysexRef, void>>(&UnsafeSysexRef::Release);
  Link<Const<UnsafeSysexRef, void*>>(&UnsafeSysexRef::_get_as_void_pointer);
  Link<Mutable<UnsafeSysexRef, void, void*>>(&UnsafeSysexRef::_set_from_void_pointer);
  Link<Const<UnsafeSysexRef, bool, UnsafeSysexRef const&>>(&UnsafeSysexRef::operator==);
}

static_assert(kIsExplicit<size_t, SysexRefBase>, "");
static_assert(kIsExplicit<size_t, SysexRef>, "");
static_assert(kIsExplicit<size_t, SysexEditRef>, "");
static_assert(kIsExplicit<RCPtrMT<Impl::SysexImpl>, SysexRefBase>, "");
static_assert(kIsExplicit<RCPtrMT<Impl::SysexImpl>, SysexRef>, "");
static_assert(kIsImplicit<SysexRefBase, SysexRef>, "");
static_assert(kIsImplicit<UnsafeSysexRef, SysexRef>, "");
static_assert(kIsImplicit<SysexEditRef, SysexRef>, "");
static_assert(std::is_constructible<SysexRefBase, unsigned char const*, size_t>::value, "");
static_assert(std::is_constructible<SysexEditRef, unsigned char const*, size_t>::value, "");
static_assert(std::has_virtual_destructor<SysexRefBase>::value, "");

TEST(Declarations, EmptyReferencesPassFromClassToClass) {
  SysexEditRef edit;
  SysexRef const ref = edit;
  SysexRefBase base(ref);
  base = SysexRefBase::kNullSysexRef;
  UnsafeSysexRef unsafe;
  unsafe.SetTo(ref);
  SysexRef other;
  other = unsafe;
  other = ref;
  unsafe.Release();
  edit.ReleaseTo(base);
  edit.CopyFrom(ref);
  base.AssignTo(RCPtrMT<Impl::SysexImpl>());
  EXPECT_TRUE(other.IsNull());
  EXPECT_TRUE(other == base);
  EXPECT_TRUE(unsafe == UnsafeSysexRef());
}

}  // namespace
}  // namespace Ostinet::Testing
