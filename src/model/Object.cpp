// SPDX-License-Identifier: MIT
#include <cstdint>
#include <functional>

#include "model/Handles.h"

namespace Ostinet {

Object::Object() = default;
Object::Object(RCPtrMT<Impl::ObjectImpl> const& impl) : impl_(impl) {}
Object::Object(Object const& other) : boost::totally_ordered1<Object>(), impl_(other.impl_) {}
Object::~Object() = default;

Object& Object::operator=(Object const& other) {
  impl_ = other.impl_;
  return *this;
}

bool Object::Exists() const { return impl_.get() != nullptr; }

UString Object::GetName() const { return impl_.get() != nullptr ? impl_->GetName() : UString(); }

void* Object::GetImplPtr() const { return impl_.get(); }

unsigned long long Object::GetKey() const {
  return static_cast<unsigned long long>(reinterpret_cast<std::uintptr_t>(impl_.get()));
}

bool Object::operator==(Object const& other) const { return impl_ == other.impl_; }

bool Object::operator<(Object const& other) const { return impl_ < other.impl_; }

}  // namespace Ostinet
