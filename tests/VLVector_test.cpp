// VLWS_IntVector and VLWS_BoolVector: insertion and erasure (also of their own
// elements), resizing, copies and their limits.
#include <gtest/gtest.h>

#include <vector>

#include "VLWS_BoolVector.h"
#include "VLWS_IntVector.h"

namespace {

template <class V>
std::vector<typename V::value_type> Items(const V& v) {
  return std::vector<typename V::value_type>(v.begin(), v.end());
}

std::vector<int32_t> Ints(std::initializer_list<int32_t> items) { return items; }

TEST(VLVector, InsertAndErase) {
  VLWS_IntVector v(3, 5);  // 5 5 5
  v[1] = 6;
  EXPECT_EQ(9, *v.insert(v.begin() + 1, 9));  // 5 9 6 5
  v.insert(v.end(), 2, 8);                    // 5 9 6 5 8 8
  const int32_t more[] = {1, 2, 3};
  EXPECT_EQ(v.begin() + 2, v.insert(v.begin() + 2, more, more + 3));
  EXPECT_EQ(Ints({5, 9, 1, 2, 3, 6, 5, 8, 8}), Items(v));
  EXPECT_EQ(v.begin() + 1, v.erase(v.begin() + 1));
  EXPECT_EQ(v.begin() + 3, v.erase(v.begin() + 3, v.begin() + 7));
  EXPECT_EQ(Ints({5, 1, 2, 8}), Items(v));
  EXPECT_EQ(v.end(), v.erase(v.end(), v.end()));
  v.pop_back();
  EXPECT_EQ(Ints({5, 1, 2}), Items(v));
  EXPECT_EQ(2, v.at(2));
  v.insert(v.begin(), more, more);  // empty range
  EXPECT_EQ(3u, v.size());
}

TEST(VLVector, InsertingItsOwnElements) {
  VLWS_IntVector v;
  v.push_back(1);
  v.push_back(2);  // full: capacity 2
  v.push_back(v[0]);
  v.insert(v.begin(), 3, v.back());
  EXPECT_EQ(Ints({1, 1, 1, 1, 2, 1}), Items(v));
  v.reserve(20);
  v.insert(v.begin(), v.begin() + 3, v.end());  // the source moves with the gap
  EXPECT_EQ(Ints({1, 2, 1, 1, 1, 1, 1, 2, 1}), Items(v));
  VLWS_IntVector w(2, 4);
  w.insert(w.begin() + 1, w.begin(), w.end());  // needs new storage
  EXPECT_EQ(Ints({4, 4, 4, 4}), Items(w));
  w.assign(3, w[0]);
  EXPECT_EQ(Ints({4, 4, 4}), Items(w));
}

TEST(VLVector, ResizeAssignAndClear) {
  VLWS_BoolVector flags(3);
  EXPECT_EQ(std::vector<bool>({false, false, false}), Items(flags));
  flags.resize(5, true);
  flags.push_back();
  EXPECT_EQ(std::vector<bool>({false, false, false, true, true, false}), Items(flags));
  flags.resize(2);
  EXPECT_EQ(2u, flags.size());
  EXPECT_EQ(6u, flags.capacity());
  flags.assign(4, true);
  EXPECT_EQ(std::vector<bool>({true, true, true, true}), Items(flags));
  flags.clear();
  EXPECT_TRUE(flags.empty());
  EXPECT_EQ(6u, flags.capacity());
  flags.pop_back();  // nothing to remove
  EXPECT_TRUE(flags.empty());
}

TEST(VLVector, CopiesAreIndependent) {
  const int32_t ids[] = {11, 22, 33};
  VLWS_IntVector a(ids, ids + 3);
  VLWS_IntVector b(a);
  b[0] = 99;
  EXPECT_EQ(11, a[0]);
  VLWS_IntVector c;
  c = a;
  c = c;
  EXPECT_EQ(Items(a), Items(c));
  VLWS_IntVector d(2, 1);
  d.swap(c);
  EXPECT_EQ(Ints({1, 1}), Items(c));
  EXPECT_EQ(Ints({11, 22, 33}), Items(d));
  VLWS_IntVector moved(std::move(d));
  EXPECT_EQ(Ints({11, 22, 33}), Items(moved));
}

TEST(VLVectorDeathTest, SizeBeyondTheLimit) {
  GTEST_FLAG_SET(death_test_style, "threadsafe");
  VLWS_IntVector v(1, 0);
  EXPECT_DEATH(v.insert(v.end(), VLWS_IntVector::max_size(), 0), "n <= MaxSize - count");
}

}  // namespace
