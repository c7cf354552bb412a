// SPDX-License-Identifier: MIT
#pragma once

#include <cstddef>
#include <iterator>

#include "ostinet/Common.h"
#include "ostinet/Export.h"

namespace Ostinet {

/// A reference on the bytes of one long MIDI message. The library looks at no byte of it: it need
/// not begin with F0 or end with F7.
///
/// Ownership    Counted. Copies share one message and see each other's changes; the bytes live
///              while any reference does. A message that was handed to the library is kept until it
///              is out, so leave the bytes of a shared message alone.
/// Null handle  Default-constructed, or made with size 0: an empty message is the null reference.
///              Pointers are null and the size is 0; operator[] must not be used.
/// Threads      References may live and die on any thread; one reference, and the bytes of one
///              message, belong to one thread at a time.
/// Errors       Storage comes from the MIDI session. Making a message of one byte or more throws a
///              VantorError while nobody is signed in, or where the system has no room; the
///              reference then keeps what it had.
class OSTINET_EXPORT SysexRefBase {
 public:
  static SysexRefBase const kNullSysexRef;

  SysexRefBase();
  /// A new message of `size` bytes, whose contents are undefined.
  explicit SysexRefBase(size_t size);
  /// A new message with a copy of `size` bytes. With null `bytes` the contents are undefined.
  SysexRefBase(unsigned char const* bytes, size_t size);
  SysexRefBase(SysexRefBase const& other);
  explicit SysexRefBase(RCPtrMT<Impl::SysexImpl> const& impl);
  virtual ~SysexRefBase();

  SysexRefBase& operator=(SysexRefBase const& other);
  /// Shares the other message.
  void AssignTo(SysexRefBase const& other);
  void AssignTo(RCPtrMT<Impl::SysexImpl> const& impl);

  unsigned char* begin() const;
  unsigned char* end() const;
  size_t size() const;
  bool empty() const;
  bool IsNull() const;
  /// The largest size_t, whatever the system's buffers hold.
  size_t max_size() const;
  std::reverse_iterator<unsigned char*> rbegin() const;
  std::reverse_iterator<unsigned char*> rend() const;
  /// The byte at `index`, which is not tested.
  unsigned char& operator[](size_t index) const;

  /// Whether both share one message; equal bytes of two messages are not equal.
  bool operator==(SysexRefBase const& other) const;
  bool operator!=(SysexRefBase const& other) const;

  /// For the library's own use: the counted message, or null.
  RCPtrMT<Impl::SysexImpl> const& GetImpl() const { return impl_; }

 protected:
  RCPtrMT<Impl::SysexImpl> impl_;
};

class UnsafeSysexRef;

/// A finished message, as it is sent.
class OSTINET_EXPORT SysexRef : public SysexRefBase {
 public:
  SysexRef();
  explicit SysexRef(size_t size);
  SysexRef(unsigned char const* bytes, size_t size);
  SysexRef(SysexRef const& other);
  SysexRef(SysexRefBase const& other);
  explicit SysexRef(RCPtrMT<Impl::SysexImpl> const& impl);
  /// Shares the message and adds a count of its own; the other's count stays.
  SysexRef(UnsafeSysexRef const& other);

  SysexRef& operator=(SysexRef const& other);
  SysexRef& operator=(UnsafeSysexRef const& other);

  /// A new message with the same bytes.
  SysexRef Copy() const;
  /// False, always: hosts wait on it before they use a message again, and the library keeps no
  /// record of what is on its way.
  bool IsSending() const;
};

/// The reference through which a message is built. What changes the length works on the shared
/// message, so every other reference on it sees the change; pointers into the message are invalid
/// after a change that made it longer. On a null reference such a change does nothing and gives a
/// null pointer.
class OSTINET_EXPORT SysexEditRef : public SysexRefBase {
 public:
  SysexEditRef();
  explicit SysexEditRef(size_t size);
  SysexEditRef(unsigned char const* bytes, size_t size);

  /// Lets go of the message and takes a new one of `size` bytes, with undefined contents; with
  /// size 0, none.
  void Reset(size_t size);
  /// Takes a new message with a copy of the other's bytes; none where there are no bytes.
  void CopyFrom(SysexRefBase const& other);
  /// A new message with a copy of the bytes.
  SysexRef CopyToSysexRef() const;
  /// Hands the message over without a copy; this reference is null afterwards.
  void ReleaseTo(SysexRefBase& target);

  /// Makes the message `size` bytes long. Bytes that are gained have undefined contents.
  void resize(size_t size) const;
  /// Puts `byte` before `position` and gives its new place. A position outside the message changes
  /// nothing and gives the end.
  unsigned char* insert(unsigned char* position, unsigned char byte) const;
  /// Puts `count` times `byte` before `position`; nothing for a position outside the message.
  void insert(unsigned char* position, size_t count, unsigned char byte) const;
  /// Takes one byte away and gives the place where it was. A position that holds no byte changes
  /// nothing and gives the end.
  unsigned char* erase(unsigned char* position) const;
  /// Takes the bytes from `first` to before `last` away and gives the place where they were. A
  /// range that does not lie in the message changes nothing and gives the end.
  unsigned char* erase(unsigned char* first, unsigned char* last) const;
};

/// Carries a reference through a `void*`, and counts only when asked to: SetTo on one side, pass
/// the pointer, and on the other side take it with _set_from_void_pointer, make a SysexRef from it,
/// Release.
///
/// Ownership    None but between SetTo and Release. A copy copies the pointer, without a count.
/// Null handle  Default-constructed and after Release.
class OSTINET_EXPORT UnsafeSysexRef {
 public:
  UnsafeSysexRef();

  /// Takes the message's pointer and adds one count. A pointer held before is forgotten, with its
  /// count still added.
  void SetTo(SysexRef const& ref);
  /// Drops one count and forgets the pointer.
  void Release();

  void* _get_as_void_pointer() const;
  /// Takes the pointer without a count.
  void _set_from_void_pointer(void* pointer);

  bool operator==(UnsafeSysexRef const& other) const;

 private:
  Impl::SysexImpl* impl_;
};

}  // namespace Ostinet
