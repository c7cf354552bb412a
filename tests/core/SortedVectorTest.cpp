// SPDX-License-Identifier: MIT
#include <gtest/gtest.h>

#include <functional>
#include <map>
#include <memory>
#include <random>
#include <set>
#include <stdexcept>
#include <string>
#include <vector>

#include "ostinet/core/SortedVector.h"

namespace Ostinet {
namespace {

TEST(SortedVectorSet, KeepsOrderAndHoldsEachKeyOnce) {
  sorted_vector_set<int> set{3, 1, 2, 3, 1};
  EXPECT_EQ(std::vector<int>(set.begin(), set.end()), (std::vector<int>{1, 2, 3}));
  auto const again = set.insert(2);
  EXPECT_FALSE(again.second);
  EXPECT_EQ(*again.first, 2);
  auto const fresh = set.insert(0);
  EXPECT_TRUE(fresh.second);
  EXPECT_EQ(fresh.first, set.begin());
}

TEST(SortedVectorSet, FollowsItsComparison) {
  sorted_vector_set<int, std::greater<int>> const set{1, 3, 2};
  EXPECT_EQ(set.nth(0), 3);
  EXPECT_EQ(set.nth(2), 1);
  EXPECT_THROW(set.nth(3), std::out_of_range);
}

TEST(SortedVectorSet, FindsAndErases) {
  sorted_vector_set<std::string> set{"b", "d"};
  EXPECT_EQ(set.count("b"), 1U);
  EXPECT_EQ(set.find("c"), set.end());
  EXPECT_EQ(*set.lower_bound("c"), "d");
  EXPECT_EQ(set.upper_bound("d"), set.end());
  EXPECT_EQ(set.erase("x"), 0U);
  EXPECT_EQ(set.erase("b"), 1U);
  set.erase(set.begin());
  EXPECT_TRUE(set.empty());
}

TEST(SortedVectorSet, ComparesByContent) {
  EXPECT_EQ((sorted_vector_set<int>{1, 2}), (sorted_vector_set<int>{2, 1}));
  EXPECT_NE((sorted_vector_set<int>{1, 2}), (sorted_vector_set<int>{1, 3}));
  EXPECT_LT((sorted_vector_set<int>{1, 2}), (sorted_vector_set<int>{1, 3}));
}

TEST(SortedVectorMap, MakesAndChangesValues) {
  sorted_vector_map<std::string, int> map;
  EXPECT_EQ(map["b"], 0);
  map["b"] = 2;
  map["a"] = 1;
  EXPECT_EQ(map.size(), 2U);
  EXPECT_EQ(map.begin()->first, "a");
  EXPECT_EQ(map.at("b"), 2);
  EXPECT_THROW(map.at("c"), std::out_of_range);
  EXPECT_FALSE(map.insert({"a", 9}).second);
  EXPECT_EQ(map.at("a"), 1);
  EXPECT_TRUE(map.emplace("c", 3).second);
}

TEST(SortedVectorMap, HoldsWhatCannotBeCopied) {
  sorted_vector_map<int, std::unique_ptr<int>> map;
  map[2] = std::make_unique<int>(5);
  map[1];
  EXPECT_EQ(*map.at(2), 5);
}

TEST(SortedVectorMap, DoesAsAStandardMapDoes) {
  std::mt19937 random(4711);
  sorted_vector_map<int, int> map;
  std::map<int, int> reference;
  for (int step = 0; step < 5000; ++step) {
    int const key = static_cast<int>(random() % 100);
    switch (random() % 3) {
      case 0:
        EXPECT_EQ(map.insert({key, step}).second, reference.insert({key, step}).second);
        break;
      case 1:
        EXPECT_EQ(map.erase(key), reference.erase(key));
        break;
      default:
        map[key] = step;
        reference[key] = step;
    }
    EXPECT_EQ(map.lower_bound(key) == map.end(), reference.lower_bound(key) == reference.end());
  }
  EXPECT_TRUE(std::equal(
      map.begin(), map.end(), reference.begin(), reference.end(),
      [](auto const& a, auto const& b) { return a.first == b.first && a.second == b.second; }));
}

}  // namespace
}  // namespace Ostinet
