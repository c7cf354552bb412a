// SPDX-License-Identifier: MIT
#pragma once

// Filters and sorted lists of endpoints and devices. Endpoint.h includes this; include that.

#include <cstddef>
#include <deque>
#include <type_traits>
#include <vector>

#include "ostinet/Endpoint.h"

namespace Ostinet {

/// A question about an endpoint or a device, to be combined with and, or and not.
///
/// Ownership    A value.
/// Threads      One at a time to change it, any number to ask it: asking changes nothing.
/// Errors       None but what a predicate throws. A filter of an empty function throws
///              boost::bad_function_call when it is asked.
template <class T>
class ObjectFilter {
 public:
  /// Always true.
  ObjectFilter() = default;
  /// Always `constant`. A template, so that no function is ever taken for a constant.
  template <class Bool, typename std::enable_if<std::is_same<Bool, bool>::value, int>::type = 0>
  explicit ObjectFilter(Bool constant) : constant_(constant) {}
  ObjectFilter(boost::function<bool(T const&)> const& predicate)
      : nodes_(1, Node{kPredicate, false, predicate}) {}

  /// The answer for `object`. What cannot change the answer any more is not asked.
  bool operator()(T const& object) const {
    std::size_t cursor = 0;
    return nodes_.empty() ? constant_ : Evaluate(object, cursor);
  }

  ObjectFilter& operator&=(ObjectFilter const& other) { return Combine(kAnd, other); }
  ObjectFilter& operator|=(ObjectFilter const& other) { return Combine(kOr, other); }
  ObjectFilter operator&(ObjectFilter const& other) const { return ObjectFilter(*this) &= other; }
  ObjectFilter operator|(ObjectFilter const& other) const { return ObjectFilter(*this) |= other; }

  /// By De Morgan's laws one pass does: every and becomes an or, every leaf its opposite.
  ObjectFilter operator!() const {
    ObjectFilter result(*this);
    result.constant_ = !constant_;
    for (Node& node : result.nodes_) {
      switch (node.kind) {
        case kAnd:
          node.kind = kOr;
          break;
        case kOr:
          node.kind = kAnd;
          break;
        case kPredicate:
          node.isNegated = !node.isNegated;
          break;
      }
    }
    return result;
  }

 private:
  enum Kind { kOr, kAnd, kPredicate };
  struct Node {
    Kind kind;
    bool isNegated;
    boost::function<bool(T const&)> predicate;
  };

  bool Evaluate(T const& object, std::size_t& cursor) const {
    Node const& node = nodes_[cursor++];
    if (node.kind == kPredicate) {
      return node.predicate(object) != node.isNegated;
    }
    bool const left = Evaluate(object, cursor);
    if (left != (node.kind == kAnd)) {
      PassOver(cursor);
      return left;
    }
    return Evaluate(object, cursor);
  }

  void PassOver(std::size_t& cursor) const {
    for (std::size_t open = 1; open != 0;) {
      if (nodes_[cursor++].kind == kPredicate) {
        --open;
      } else {
        ++open;
      }
    }
  }

  ObjectFilter& Combine(Kind kind, ObjectFilter other) {
    bool const neutral = kind == kAnd;
    if (other.nodes_.empty()) {
      if (other.constant_ != neutral) {
        nodes_.clear();
        constant_ = !neutral;
      }
    } else if (nodes_.empty()) {
      if (constant_ == neutral) {
        *this = other;
      }
    } else {
      nodes_.push_front(Node{kind, false, boost::function<bool(T const&)>()});
      nodes_.insert(nodes_.end(), other.nodes_.begin(), other.nodes_.end());
    }
    return *this;
  }

  std::deque<Node> nodes_;  // in prefix order: an operator stands before its two sides
  bool constant_ = true;    // the answer where there are no nodes
};

/// The filters that hosts build theirs from. Each lives to the end of the process.
OSTINET_EXPORT ObjectFilter<Endpoint>& DirectEndpoint();
OSTINET_EXPORT ObjectFilter<Endpoint>& OnlineEndpoint();
OSTINET_EXPORT ObjectFilter<Endpoint>& PublicEndpoint();
OSTINET_EXPORT ObjectFilter<Endpoint>& SoftwareEndpoint();
/// IsInterface says yes.
OSTINET_EXPORT ObjectFilter<Endpoint>& DefinitelyInterfaceEndpoint();
/// IsInterface says no.
OSTINET_EXPORT ObjectFilter<Endpoint>& DefinitelyNonInterfaceEndpoint();
/// IsInterface says yes or does not know.
OSTINET_EXPORT ObjectFilter<Endpoint>& CouldBeInterfaceEndpoint();
/// IsInterface says no or does not know.
OSTINET_EXPORT ObjectFilter<Endpoint>& CouldBeNonInterfaceEndpoint();
/// A port without an entity: neither a user's device nor software.
OSTINET_EXPORT ObjectFilter<Endpoint>& EntitylessNonSoftwareEndpoint();
OSTINET_EXPORT ObjectFilter<Device>& DirectDevice();

/// A snapshot of the public destinations that pass a filter. Its members stay valid when the
/// studio changes, and may then be dead; Reset it after SetupChanged.
///
/// Ownership    A value that holds handles.
/// Threads      The host's polling thread.
/// Errors       None but what a filter throws.
class OSTINET_EXPORT DestinationList : public std::vector<Destination> {
 public:
  /// The usual order, to be given to Sort: instruments that are online, those that are not,
  /// interfaces, and whatever cannot be told. Filled by the first list that is made.
  static std::vector<ObjectFilter<Endpoint> > sDefaultSortFilters;

  /// Empty until Reset.
  DestinationList();
  explicit DestinationList(ObjectFilter<Endpoint> const& filter);
  /// Takes the snapshot anew.
  void Reset(ObjectFilter<Endpoint> const& filter);
  /// Sorts by name, then puts what passes a filter in front of what does not, the first filter
  /// weighing most.
  void Sort(std::vector<ObjectFilter<Endpoint> >& filters);
};

/// A snapshot of the public sources that pass a filter; otherwise as DestinationList.
class OSTINET_EXPORT SourceList : public std::vector<Source> {
 public:
  static std::vector<ObjectFilter<Endpoint> > sDefaultSortFilters;

  SourceList();
  explicit SourceList(ObjectFilter<Endpoint> const& filter);
  void Reset(ObjectFilter<Endpoint> const& filter);
  void Sort(std::vector<ObjectFilter<Endpoint> >& filters);
};

/// A snapshot of the devices that pass a filter, in the order of the studio.
class OSTINET_EXPORT DeviceList : public std::vector<Device> {
 public:
  DeviceList();
  explicit DeviceList(ObjectFilter<Device> const& filter);
  void Reset(ObjectFilter<Device> const& filter);
};

}  // namespace Ostinet
