// SPDX-License-Identifier: MIT
#pragma once

#include <algorithm>
#include <cstddef>
#include <functional>
#include <initializer_list>
#include <stdexcept>
#include <utility>
#include <vector>

namespace Ostinet {

// One sorted vector serves both containers: `KeyOf` takes the key out of an element.
namespace Impl {

template <class Key, class Value, class KeyOf, class Compare>
class SortedVector {
 public:
  using key_type = Key;
  using value_type = Value;
  using key_compare = Compare;
  using size_type = std::size_t;
  using container_type = std::vector<Value>;
  using iterator = typename container_type::iterator;
  using const_iterator = typename container_type::const_iterator;
  using reverse_iterator = typename container_type::reverse_iterator;
  using const_reverse_iterator = typename container_type::const_reverse_iterator;

  SortedVector() = default;
  explicit SortedVector(Compare const& compare) : compare_(compare) {}

  iterator begin() noexcept { return elements_.begin(); }
  iterator end() noexcept { return elements_.end(); }
  const_iterator begin() const noexcept { return elements_.begin(); }
  const_iterator end() const noexcept { return elements_.end(); }
  const_iterator cbegin() const noexcept { return elements_.begin(); }
  const_iterator cend() const noexcept { return elements_.end(); }
  reverse_iterator rbegin() noexcept { return elements_.rbegin(); }
  reverse_iterator rend() noexcept { return elements_.rend(); }
  const_reverse_iterator rbegin() const noexcept { return elements_.rbegin(); }
  const_reverse_iterator rend() const noexcept { return elements_.rend(); }

  bool empty() const noexcept { return elements_.empty(); }
  size_type size() const noexcept { return elements_.size(); }
  void clear() noexcept { elements_.clear(); }
  void reserve(size_type count) { elements_.reserve(count); }
  void swap(SortedVector& other) noexcept {
    elements_.swap(other.elements_);
    std::swap(compare_, other.compare_);
  }
  Compare key_comp() const { return compare_; }
  /// The element at a place of the sorted order, 0 to size() - 1.
  Value const& nth(size_type index) const { return elements_.at(index); }

  iterator lower_bound(Key const& key) {
    return std::lower_bound(begin(), end(), key, ElementLess{compare_});
  }
  const_iterator lower_bound(Key const& key) const {
    return std::lower_bound(begin(), end(), key, ElementLess{compare_});
  }
  iterator upper_bound(Key const& key) {
    return std::upper_bound(begin(), end(), key, KeyLess{compare_});
  }
  const_iterator upper_bound(Key const& key) const {
    return std::upper_bound(begin(), end(), key, KeyLess{compare_});
  }
  std::pair<iterator, iterator> equal_range(Key const& key) {
    return {lower_bound(key), upper_bound(key)};
  }
  std::pair<const_iterator, const_iterator> equal_range(Key const& key) const {
    return {lower_bound(key), upper_bound(key)};
  }
  iterator find(Key const& key) {
    iterator const place = lower_bound(key);
    return Holds(place, key) ? place : end();
  }
  const_iterator find(Key const& key) const {
    const_iterator const place = lower_bound(key);
    return Holds(place, key) ? place : end();
  }
  size_type count(Key const& key) const { return find(key) == end() ? 0 : 1; }

  /// Puts an element in its place unless one of its key is there: the element of that key, and
  /// whether it is the new one.
  std::pair<iterator, bool> insert(Value const& element) { return insert(Value(element)); }
  std::pair<iterator, bool> insert(Value&& element) {
    iterator const place = lower_bound(KeyOf()(element));
    if (Holds(place, KeyOf()(element))) {
      return {place, false};
    }
    return {elements_.insert(place, std::move(element)), true};
  }
  iterator insert(const_iterator, Value const& element) { return insert(element).first; }
  template <class Iterator>
  void insert(Iterator first, Iterator last) {
    for (; first != last; ++first) {
      insert(*first);
    }
  }
  template <class... Arguments>
  std::pair<iterator, bool> emplace(Arguments&&... arguments) {
    return insert(Value(std::forward<Arguments>(arguments)...));
  }
  iterator erase(const_iterator place) { return elements_.erase(place); }
  iterator erase(const_iterator first, const_iterator last) { return elements_.erase(first, last); }
  size_type erase(Key const& key) {
    iterator const place = find(key);
    if (place == end()) {
      return 0;
    }
    elements_.erase(place);
    return 1;
  }

  friend bool operator==(SortedVector const& a, SortedVector const& b) {
    return a.elements_ == b.elements_;
  }
  friend bool operator!=(SortedVector const& a, SortedVector const& b) { return !(a == b); }
  friend bool operator<(SortedVector const& a, SortedVector const& b) {
    return a.elements_ < b.elements_;
  }

 protected:
  template <class Iterator>
  bool Holds(Iterator place, Key const& key) const {
    return place != elements_.end() && !compare_(key, KeyOf()(*place));
  }

  container_type elements_;
  Compare compare_{};

 private:
  struct ElementLess {
    Compare const& compare;
    bool operator()(Value const& element, Key const& key) const {
      return compare(KeyOf()(element), key);
    }
  };
  struct KeyLess {
    Compare const& compare;
    bool operator()(Key const& key, Value const& element) const {
      return compare(key, KeyOf()(element));
    }
  };
};

template <class Key>
struct ElementIsKey {
  Key const& operator()(Key const& element) const { return element; }
};

template <class Key, class Mapped>
struct KeyOfPair {
  Key const& operator()(std::pair<Key, Mapped> const& element) const { return element.first; }
};

}  // namespace Impl

/// The interface of std::set over a sorted vector: small, quick to walk, and insertions move
/// what is behind, so places do not outlive a change.
///
/// Threads      As a standard container.
template <class Key, class Compare = std::less<Key>>
class sorted_vector_set : public Impl::SortedVector<Key, Key, Impl::ElementIsKey<Key>, Compare> {
  using Base = Impl::SortedVector<Key, Key, Impl::ElementIsKey<Key>, Compare>;

 public:
  sorted_vector_set() = default;
  explicit sorted_vector_set(Compare const& compare) : Base(compare) {}
  sorted_vector_set(std::initializer_list<Key> elements) {
    this->insert(elements.begin(), elements.end());
  }
  template <class Iterator>
  sorted_vector_set(Iterator first, Iterator last) {
    this->insert(first, last);
  }
};

/// The interface of std::map over a sorted vector. An element's key is not to be changed.
///
/// Threads      As a standard container.
template <class Key, class Mapped, class Compare = std::less<Key>>
class sorted_vector_map : public Impl::SortedVector<Key, std::pair<Key, Mapped>,
                                                    Impl::KeyOfPair<Key, Mapped>, Compare> {
  using Base =
      Impl::SortedVector<Key, std::pair<Key, Mapped>, Impl::KeyOfPair<Key, Mapped>, Compare>;

 public:
  using mapped_type = Mapped;
  using value_type = std::pair<Key, Mapped>;

  sorted_vector_map() = default;
  explicit sorted_vector_map(Compare const& compare) : Base(compare) {}
  sorted_vector_map(std::initializer_list<value_type> elements) {
    this->insert(elements.begin(), elements.end());
  }
  template <class Iterator>
  sorted_vector_map(Iterator first, Iterator last) {
    this->insert(first, last);
  }

  /// The value of `key`, made by default if there is none.
  Mapped& operator[](Key const& key) {
    auto place = this->lower_bound(key);
    if (!this->Holds(place, key)) {
      place = this->elements_.insert(place, value_type(key, Mapped()));
    }
    return place->second;
  }
  /// Throws std::out_of_range if there is none.
  Mapped& at(Key const& key) {
    auto const place = this->find(key);
    if (place == this->end()) {
      throw std::out_of_range("sorted_vector_map::at");
    }
    return place->second;
  }
  Mapped const& at(Key const& key) const {
    auto const place = this->find(key);
    if (place == this->end()) {
      throw std::out_of_range("sorted_vector_map::at");
    }
    return place->second;
  }
};

}  // namespace Ostinet
