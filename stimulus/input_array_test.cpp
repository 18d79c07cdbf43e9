#include "lumen/stimulus/input_array.h"

#include <gtest/gtest.h>

#include <cmath>
#include <functional>
#include <sstream>

#include "lumen/platform/lumen_exception.h"

namespace LumenUtility {
namespace {

// LIN 1..3 (3 points), FIX 5 (2 points), ARB 7, 9: points 1 2 3 5 5 7 9.
InputArray ThreeSegmentArray() {
  InputArray a(1, 3, 3, Linear);
  a.push_back(Segment(5.0, 2));
  a.push_back(Segment(std::vector<double>{7, 9}));
  return a;
}

std::wstring MessageOf(const std::function<void()>& f) {
  try {
    f();
  } catch (const LumenException& e) {
    return e.GetMessage();
  }
  return L"nothing thrown";
}

TEST(InputArray, ReadsAcrossSegmentsDirectlyAndThroughTheFlattenedCache) {
  const InputArray a = ThreeSegmentArray();
  EXPECT_EQ(a.size(), 7u);
  EXPECT_EQ(a.GetArray(), (std::vector<double>{1, 2, 3, 5, 5, 7, 9}));
  EXPECT_EQ(std::vector<double>(a.begin(), a.end()), a.GetArray());
  EXPECT_EQ(MessageOf([&] { a[7]; }), L"index");
  EXPECT_EQ(a.GetSegmentFromPtIndex(4).GetType(), Fixed);
  for (int bad : {7, -1}) EXPECT_EQ(MessageOf([&] { a.GetSegmentFromPtIndex(bad); }), L"index");
  EXPECT_EQ(MessageOf([&] { a.GetSegment(3); }), L"segIndex");
  EXPECT_EQ(std::make_pair(a.min_element(), a.max_element()), std::make_pair(1.0, 9.0));
  EXPECT_EQ(MessageOf([] { InputArray()[0]; }), L"index");

  // The flattened cache serves the same values through one shared vector.
  const double* raw = a.GetRawArray();
  ASSERT_NE(raw, nullptr);
  EXPECT_EQ(std::vector<double>(raw, raw + a.size()), a.GetArray());
  EXPECT_EQ(a.GetArrayPtr().get()->data(), raw);
  EXPECT_EQ(InputArray().GetRawArray(), nullptr);
}

TEST(InputArray, CopiesAreIsolatedOnChange) {
  InputArray original = ThreeSegmentArray();
  original.GetRawArray();  // segments now share one flattened cache
  InputArray copy = original;
  copy.push_back(Segment(11.0, 1));
  copy += 100;
  copy.ReplaceSegment(Segment(std::vector<double>{-1}), 2);
  EXPECT_EQ(original.size(), 7u);
  EXPECT_EQ(original.GetArray(), (std::vector<double>{1, 2, 3, 5, 5, 7, 9}));
  EXPECT_EQ(original.GetSegments()[2].GetArray(), (std::vector<double>{7, 9}));
  EXPECT_EQ(copy.GetArray(), (std::vector<double>{101, 102, 103, 105, 105, -1, 111}));

  InputArray scaled = original;
  scaled *= 2;
  scaled.reverse();
  EXPECT_EQ(original[6], 9);
  EXPECT_EQ(scaled.GetArray(), (std::vector<double>{18, 14, 10, 10, 6, 4, 2}));
}

TEST(InputArray, SegmentListEditing) {
  InputArray a = ThreeSegmentArray();
  a.insert(Segment(0.0, 1), 0);
  EXPECT_EQ(a.GetArray(), (std::vector<double>{0, 1, 2, 3, 5, 5, 7, 9}));
  a.erase(0);
  a.erase(17);  // out of range: nothing
  a.pop_back();
  EXPECT_EQ(a.GetArray(), (std::vector<double>{1, 2, 3, 5, 5}));
  EXPECT_EQ(MessageOf([&] { a.insert(Segment(), 9); }), L"segIndex");
  EXPECT_EQ(MessageOf([&] { a.ReplaceSegment(Segment(), 2); }), L"segIndex");
  a += a;  // concatenation with itself
  EXPECT_EQ(a.GetArray(), (std::vector<double>{1, 2, 3, 5, 5, 1, 2, 3, 5, 5}));
  InputArray empty;
  empty.pop_back();
  empty.reverse();
  EXPECT_NE(MessageOf([&] { empty.min_element(); }).find(L"no segments"), std::wstring::npos);
}

TEST(InputArray, OptimizeRepresentationFindsLinearRuns) {
  InputArray a(std::vector<double>{0, 1, 2, 3, 10, 20, 30});
  a.OptimizeRepresentation();
  EXPECT_EQ(a.GetSegments(),
            (std::vector<Segment>{Segment(0, 3, 4, Linear), Segment(10, 30, 3, Linear)}));

  InputArray b(std::vector<double>{0, 1, 5, 6, 20});
  b.OptimizeRepresentation();
  EXPECT_EQ(b.GetSegment(2), Segment(20.0, 1));

  InputArray c(std::vector<double>{1, 2.004, 3.006});
  c.OptimizeRepresentation();
  ASSERT_EQ(c.NumSegments(), 1u);
  EXPECT_DOUBLE_EQ(c[1], 2.003);

  InputArray ramp(0, 10, 11, Linear);
  const InputArray before = ramp;
  ramp.OptimizeRepresentation();
  EXPECT_EQ(ramp.GetSegment(0), before.GetSegment(0));

  InputArray constants(std::vector<double>{5, 5, 5, 7, 7});
  constants.OptimizeRepresentationOnlyFixed();
  EXPECT_EQ(constants.GetSegments(), (std::vector<Segment>{Segment(5.0, 3), Segment(7.0, 2)}));
}

TEST(InputArray, ExtractTakesIndicesInOrderAndCompacts) {
  const InputArray a(0, 100, 101, Linear);
  const InputArray picked = a.ExtractInputArray({10, 11, 12, 50, 50});
  EXPECT_EQ(picked.GetArray(), (std::vector<double>{10, 11, 12, 50, 50}));
  EXPECT_EQ(picked.NumSegments(), 2u);
  EXPECT_EQ(MessageOf([&] { a.ExtractInputArray({101}); }), L"index");
}

TEST(InputArray, SplitSegmentKeepsTypeAndRejectsBadSplitPoints) {
  InputArray log(1, 1000, 4, Log);
  log.SplitSegment(0, 2);
  ASSERT_EQ(log.NumSegments(), 2u);
  EXPECT_EQ(log.GetSegment(0).GetType(), Log);
  EXPECT_DOUBLE_EQ(log.GetSegment(0).back(), 10);
  EXPECT_DOUBLE_EQ(log.GetSegment(1).front(), 100);
  EXPECT_EQ(log.GetSegment(1).back(), 1000);

  InputArray arb(std::vector<double>{4, 1, 3});
  arb.SplitSegment(0, 1);
  EXPECT_EQ(arb.GetArray(), (std::vector<double>{4, 1, 3}));
  EXPECT_EQ(arb.NumSegments(), 2u);

  try {
    arb.SplitSegment(0, 0);
    ADD_FAILURE() << "no throw";
  } catch (HRESULT code) {
    EXPECT_EQ(code, E_INVALIDARG);
  }
  EXPECT_NE(MessageOf([&] { arb.SplitSegment(1, 2); }), L"nothing thrown");
  EXPECT_EQ(MessageOf([&] { arb.SplitSegment(5, 1); }), L"segIndex");
}

TEST(InputArray, ConformSegmentsAlignsBoundaries) {
  InputArray split(1, 4, 4, Linear);
  split.push_back(Segment(5, 10, 6, Linear));
  std::vector<InputArray> arrays = {InputArray(1, 10, 10, Linear), split};
  ConformSegments(arrays);
  ASSERT_EQ(arrays[0].NumSegments(), 2u);
  EXPECT_EQ(arrays[0].GetSegment(0), Segment(1, 4, 4, Linear));
  EXPECT_EQ(arrays[0].GetSegment(1), Segment(5, 10, 6, Linear));

  std::vector<InputArray> withArbitrary = {InputArray(std::vector<double>{1, 2, 4}),
                                           InputArray(1, 3, 3, Linear)};
  ConformSegments(withArbitrary);
  for (const InputArray& a : withArbitrary) {
    ASSERT_EQ(a.NumSegments(), 1u);
    EXPECT_TRUE(a.GetSegment(0).IsArbitrary());
  }

  std::vector<InputArray> uneven = {InputArray(1, 3, 3, Linear), InputArray(1, 4, 4, Linear)};
  EXPECT_NE(MessageOf([&] { ConformSegments(uneven); }), L"nothing thrown");
}

TEST(InputArray, SubsetShapeAndEqualityQuestions) {
  const InputArray range(1, 10, 10, Linear);
  const InputArray other(0.5, 9.95, 10, Linear);
  EXPECT_FALSE(range.IsSubsetOf(other, 0));
  EXPECT_TRUE(range.IsSubsetOf(other, 0.1));
  EXPECT_FALSE(InputArray(std::vector<double>{1, 2, 2})
                   .IsExactSubset(InputArray(std::vector<double>{1, 2, 3})));
  EXPECT_TRUE(InputArray(std::vector<double>{1, 2, 2})
                  .IsExactSubset(InputArray(std::vector<double>{2, 1, 2, 5})));
  EXPECT_FALSE(
      InputArray(std::vector<double>{NAN}).IsExactSubset(InputArray(std::vector<double>{NAN})));

  EXPECT_TRUE(InputArray(std::vector<double>{3, 2, 2, 1}).IsMonotonic());
  EXPECT_FALSE(InputArray(std::vector<double>{1, 3, 2, 4}).IsMonotonic());
  EXPECT_FALSE(InputArray().IsMonotonic());
  EXPECT_TRUE(InputArray(4.0, 3).IsConstant());
  InputArray constants(4.0, 3);
  constants.push_back(Segment(4.0, 2));
  EXPECT_TRUE(constants.IsConstant());
  constants.push_back(Segment(5.0, 1));
  EXPECT_FALSE(constants.IsConstant());
  EXPECT_TRUE(range.IsRamp());
  EXPECT_FALSE(ThreeSegmentArray().IsRamp());

  std::vector<int> indices = {99};
  ThreeSegmentArray().SplitInputArrayAtValue(3, 5, indices);
  EXPECT_EQ(indices, (std::vector<int>{2, 3, 4}));

  // Equality compares points, whatever the representation.
  EXPECT_EQ(InputArray(0, 4, 5, Linear), InputArray(std::vector<double>{0, 1, 2, 3, 4}));
  EXPECT_NE(InputArray(0, 4, 5, Linear), InputArray(0, 4, 4, Linear));
  EXPECT_EQ(InputArray(), InputArray());
  InputArray split(0, 4, 5, Linear);
  split.SplitSegment(0, 2);
  EXPECT_EQ(split, InputArray(0, 4, 5, Linear));
}

TEST(InputArray, ResizeOnlyForOneSegment) {
  InputArray a(1, 10, 10, Linear);
  EXPECT_TRUE(a.Resize(5));
  EXPECT_EQ(a.GetArray(), (std::vector<double>{1, 3.25, 5.5, 7.75, 10}));
  EXPECT_FALSE(a.Resize(5));
  EXPECT_FALSE(ThreeSegmentArray().Resize(2));
  InputArray arb(std::vector<double>{1, 2, 3});
  EXPECT_TRUE(arb.Resize(2));
  EXPECT_EQ(arb.GetArray(), (std::vector<double>{1, 2}));
  EXPECT_NE(MessageOf([&] { arb.Resize(3); }), L"nothing thrown");
  EXPECT_EQ(arb.size(), 2u);
}

TEST(InputArray, TextFormRoundTripsAndMalformedTextLeavesTheTarget) {
  std::wostringstream out;
  out << InputArray(10e6, 2e9, 201, Linear);
  EXPECT_EQ(out.str(), L"(LIN,201,10000000,2000000000)");

  InputArray multi = ThreeSegmentArray();
  multi.push_back(Segment(1e3, 1e9, 61, Log));
  std::wstringstream text;
  text << multi;
  InputArray back;
  text >> back;
  EXPECT_FALSE(text.fail()) << text.str();
  EXPECT_EQ(back, multi);
  EXPECT_EQ(back.NumSegments(), multi.NumSegments());

  // Malformed text fails and leaves the target as it was.
  const InputArray kept(1, 2, 2, Linear);
  for (const wchar_t* bad :
       {L"LIN,2,1,2", L"(LIN,2,1,2", L"(LIN,2,1,2]", L"(XYZ,1,1)", L"(ARB,99999999,1,2)", L"("}) {
    std::wistringstream text(bad);
    InputArray target = kept;
    text >> target;
    EXPECT_TRUE(text.fail()) << bad;
    EXPECT_EQ(target, kept) << bad;
  }
  std::wistringstream empty(L"()");
  InputArray target = kept;
  empty >> target;
  EXPECT_TRUE(target.empty());
}

}  // namespace
}  // namespace LumenUtility
