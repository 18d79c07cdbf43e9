#include "lumen/data/data_matrix.h"

#include <gtest/gtest.h>

#include <cmath>
#include <complex>
#include <random>
#include <string>
#include <utility>
#include <vector>

#include "lumen/platform/lumen_exception.h"
#include "platform/caught_lumen.h"

namespace LumenUtility {
namespace {

using Samples = std::vector<TsComplex>;

using testutil::CaughtLumen;

// Samples k + base + (k - base) j, distinct for every buffer that gets its own base.
Samples Ramp(int n, float base) {
  Samples s(n);
  for (int k = 0; k < n; ++k) s[k] = TsComplex(k + base, k - base);
  return s;
}

// Writes `samples` into the named buffer through the pointer the matrix hands out.
void Fill(DataMatrix& m, const wchar_t* name, const Samples& samples) {
  TsComplex* p = m.GetDataByName(name);
  ASSERT_NE(p, nullptr) << name;
  for (std::size_t k = 0; k < samples.size(); ++k) p[k] = samples[k];
}

Samples Read(const DataMatrix& m, const wchar_t* name) {
  Samples out;
  EXPECT_TRUE(m.GetDataByName(name, out)) << name;
  return out;
}

TEST(DataMatrix, PortListNamesBuffersAfterPhysicalPorts) {
  const DataMatrix empty;
  EXPECT_EQ(empty.Size(), 0);
  EXPECT_EQ(empty.BufferSize(), 0);
  EXPECT_EQ(empty.GetValidIndex(), -1);

  const DataMatrix twoPort(2, {1, 2}, 3);
  EXPECT_EQ(twoPort.GetValidIndex(), 0);
  EXPECT_EQ(twoPort.Size(), 4);
  for (const wchar_t* name : {L"S11", L"S12", L"S21", L"S22"}) {
    EXPECT_EQ(Read(twoPort, name), Samples(3)) << name;
  }
  const DataMatrix wide(2, {1, 12}, 1);
  EXPECT_EQ(wide.Size(), 4);
  for (const wchar_t* name : {L"S11", L"S1_12", L"S12_1", L"S12_12"}) {
    EXPECT_NE(wide.GetDataByName(name), nullptr) << name;
  }
  EXPECT_EQ(wide.GetPhysicalPorts(), (std::vector<int>{1, 12}));
}

TEST(DataMatrix, ShortPortListOrNegativeSizeIsRejectedWithNothingChanged) {
  const std::pair<HRESULT, std::wstring> shortList{
      E_FAIL, L"DataMatrix: fewer physical ports than the port count"};
  const std::pair<HRESULT, std::wstring> negative{E_FAIL, L"DataMatrix: negative buffer size"};
  EXPECT_EQ(CaughtLumen([] { DataMatrix(3, {1, 2}, 5); }), shortList);
  EXPECT_EQ(CaughtLumen([] { DataMatrix(1, {1}, -1); }), negative);
  EXPECT_EQ(CaughtLumen([] { DataMatrix({L"A"}, -2); }), negative);

  DataMatrix m(2, {1, 2}, 4);
  EXPECT_EQ(CaughtLumen([&] { m.Resize(3, 8); }), shortList);
  EXPECT_EQ(CaughtLumen([&] { m.Resize(2, -8); }), negative);
  EXPECT_EQ(m.BufferSize(), 4);
  EXPECT_EQ(m.Size(), 4);
}

TEST(DataMatrix, PhysicalPortLookupNeedsBothPortsMapped) {
  DataMatrix m(2, {1, 2}, 2);
  m.AddBuffer(L"S31");
  Samples out{TsComplex(9, 9)};
  EXPECT_FALSE(m.GetDataByPhysicalPort(3, 1, out));
  EXPECT_FALSE(m.GetDataByPhysicalPort(1, 3, out));
  const std::vector<TsComplex>* whole = nullptr;
  EXPECT_FALSE(m.GetDataByPhysicalPort(3, 1, &whole));
  EXPECT_EQ(whole, nullptr);
  EXPECT_FALSE(m.SetDataByPhysicalPort(3, 1, Samples(2)));
  EXPECT_EQ(out, Samples{TsComplex(9, 9)});
  EXPECT_TRUE(m.GetDataByName(L"S31", out));  // the buffer itself is there

  EXPECT_TRUE(m.HasPortMapping({}));
  EXPECT_TRUE(m.HasPortMapping({2, 1}));
  EXPECT_FALSE(m.HasPortMapping({1, 3}));
}

TEST(DataMatrix, WholeBufferCallsReplaceTheOutputAndPartialOnesKeepTheRest) {
  DataMatrix m(2, {1, 2}, 4);
  ASSERT_TRUE(m.SetDataByPhysicalPort(2, 1, Ramp(4, 10)));
  const Samples s21 = Ramp(4, 10);

  for (int oldLength : {0, 2, 9}) {  // stop = -1 and stop = size are whole-buffer calls
    Samples out(oldLength, TsComplex(-1, -1));
    ASSERT_TRUE(m.GetDataByPhysicalPort(2, 1, out));
    EXPECT_EQ(out, s21);
    Samples explicitStop(oldLength);
    ASSERT_TRUE(m.GetDataByPhysicalPort(2, 1, explicitStop, 0, 4));
    EXPECT_EQ(explicitStop, s21);
  }

  Samples out(5, TsComplex(-1, -1));
  ASSERT_TRUE(m.GetDataByPhysicalPort(2, 1, out, 1, 3));
  EXPECT_EQ(out,
            (Samples{TsComplex(-1, -1), s21[1], s21[2], TsComplex(-1, -1), TsComplex(-1, -1)}));
  ASSERT_TRUE(m.GetDataByPhysicalPort(2, 1, out, 2, -1));
  EXPECT_EQ(out[3], s21[3]);

  // Ranges that do not fit leave the output untouched.
  const Samples before = out;
  Samples tooShort(2);
  EXPECT_FALSE(m.GetDataByPhysicalPort(2, 1, tooShort, 1, 3));
  EXPECT_FALSE(m.GetDataByPhysicalPort(2, 1, out, 3, 1));   // start > stop
  EXPECT_FALSE(m.GetDataByPhysicalPort(2, 1, out, 4, -1));  // start at the size
  EXPECT_FALSE(m.GetDataByPhysicalPort(2, 1, out, 0, 5));   // stop past the size
  EXPECT_FALSE(m.GetDataByPhysicalPort(2, 1, out, -1, 2));
  EXPECT_EQ(out, before);
  EXPECT_EQ(tooShort, Samples(2));

  // The pointer forms.
  const TsComplex* p = &before[0];
  ASSERT_TRUE(m.GetDataByPhysicalPort(2, 1, &p, 2, 4));
  EXPECT_EQ(*p, s21[2]);
  EXPECT_FALSE(m.GetDataByPhysicalPort(2, 1, &p, 0, 5));
  EXPECT_EQ(p, nullptr);
  const std::vector<TsComplex>* whole = nullptr;
  ASSERT_TRUE(m.GetDataByPhysicalPort(2, 1, &whole));
  EXPECT_EQ(*whole, s21);
}

TEST(DataMatrix, PartialWritesTouchOnlyTheirRange) {
  DataMatrix m(1, {3}, 4);
  const Samples in = Ramp(4, 1);
  ASSERT_TRUE(m.SetDataByPhysicalPort(3, 3, in, 1, 3));
  EXPECT_EQ(Read(m, L"S33"), (Samples{TsComplex(), in[1], in[2], TsComplex()}));
  EXPECT_FALSE(m.SetDataByPhysicalPort(3, 3, Samples(2), 1, 3));  // input shorter than stop
  EXPECT_FALSE(m.SetDataByPhysicalPort(3, 3, in, 2, 1));
  EXPECT_FALSE(m.SetDataByPhysicalPort(3, 3, in, 0, 5));
  EXPECT_EQ(Read(m, L"S33"), (Samples{TsComplex(), in[1], in[2], TsComplex()}));
}

TEST(DataMatrix, CopiesStopAtTheBufferOwnLength) {
  // Set whole from a shorter vector, a buffer holds fewer samples than the matrix's size.
  DataMatrix m(2, {1, 2}, 6);
  ASSERT_TRUE(m.SetDataByPhysicalPort(1, 2, Ramp(2, 5)));
  Samples out(6, TsComplex(7, 7));
  EXPECT_FALSE(m.GetDataByPhysicalPort(1, 2, out, 1, 4));
  EXPECT_FALSE(m.GetDataByName(L"S12", out, 0, 3));
  const TsComplex* p = nullptr;
  EXPECT_FALSE(m.GetDataByPhysicalPort(1, 2, &p, 0, 3));
  EXPECT_EQ(out, Samples(6, TsComplex(7, 7)));
  ASSERT_TRUE(m.GetDataByPhysicalPort(1, 2, out, 1, 2));  // what the buffer has is fine
  EXPECT_EQ(out[1], Ramp(2, 5)[1]);
  ASSERT_TRUE(m.GetDataByPhysicalPort(1, 2, out));  // whole: the buffer as it is
  EXPECT_EQ(out, Ramp(2, 5));

  // Buffers outside a smaller Resize keep their old, shorter length.
  DataMatrix three(3, {1, 2, 3}, 2);
  three.AddBuffer(L"extra");
  three.Resize(2, 5);
  EXPECT_EQ(three.Size(), 10);
  EXPECT_EQ(Read(three, L"S22").size(), 5u);
  EXPECT_EQ(Read(three, L"S13").size(), 2u);
  EXPECT_EQ(Read(three, L"extra").size(), 2u);
  Samples five(5);
  EXPECT_FALSE(three.GetDataByName(L"S31", five, 1, 4));
  EXPECT_FALSE(three.GetDataByPhysicalPort(1, 3, five, 1, 4));
}

TEST(DataMatrix, CallOperatorFindsThePairOrTheOnlyBuffer) {
  DataMatrix single({L"A"}, 2);
  EXPECT_EQ(single(0, 0).GetName(), L"A");

  DataMatrix m(2, {3, 4}, 2);
  EXPECT_EQ(m(1, 0).GetName(), L"S43");
  EXPECT_EQ(m(0, 1).GetName(), L"S34");
  const std::pair<HRESULT, std::wstring> outOfRange{E_FAIL,
                                                    L"DataMatrix: logical port index out of range"};
  EXPECT_EQ(CaughtLumen([&] { m(2, 0); }), outOfRange);
  EXPECT_EQ(CaughtLumen([&] { m(0, -1); }), outOfRange);
  EXPECT_EQ(CaughtLumen([&] { DataMatrix({L"A", L"B"}, 1)(0, 0); }), outOfRange);

  DataMatrix unsized(0, {1, 2}, 3);  // ports listed, no buffers made
  EXPECT_EQ(CaughtLumen([&] { unsized(1, 1); }),
            std::make_pair(E_FAIL, std::wstring(L"DataMatrix: no buffer S22")));
}

TEST(DataMatrix, AliasesAreFollowedOneLevelDeep) {
  DataMatrix m(2, {1, 2}, 3);
  Fill(m, L"S21", Ramp(3, 1));
  Fill(m, L"S12", Ramp(3, 2));
  m.AddAlias(L"fwd", L"S12");
  m.AddAlias(L"fwd", L"S21");  // the later target replaces the earlier one
  m.AddAlias(L"again", L"fwd");
  EXPECT_EQ(Read(m, L"fwd"), Ramp(3, 1));
  EXPECT_EQ(m.GetDataByName(L"fwd"), m.GetDataByName(L"S21"));
  const std::vector<TsComplex>* p = nullptr;
  ASSERT_TRUE(m.GetPointerToDataByName(L"fwd", p));
  EXPECT_EQ(*p, Ramp(3, 1));

  Samples out{TsComplex(4, 4)};
  EXPECT_FALSE(m.GetDataByName(L"again", out));
  EXPECT_EQ(m.GetDataByName(L"again"), nullptr);
  EXPECT_FALSE(m.GetPointerToDataByName(L"again", p));
  EXPECT_FALSE(m.GetDataByName(L"S33", out));
  EXPECT_EQ(out, Samples{TsComplex(4, 4)});
  // An alias does not name the buffer for its aux name.
  EXPECT_FALSE(m.SetAuxNameByName(L"fwd", L"forward"));
}

// The quotient the ratio name must give, in double precision.
std::complex<double> Expected(TsComplex n, TsComplex d) {
  return std::complex<double>(n.re, n.im) / std::complex<double>(d.re, d.im);
}

TEST(DataMatrix, RatioNameDividesNumeratorByDenominatorSampleBySample) {
  constexpr int kPoints = 200;
  DataMatrix m({L"A,1", L"R1,1", L"B,1"}, kPoints);
  std::mt19937 random(7);
  std::uniform_real_distribution<float> value(-100.0f, 100.0f);
  Samples a(kPoints), r(kPoints);
  for (int k = 0; k < kPoints; ++k) {
    a[k] = TsComplex(value(random), value(random));
    r[k] = TsComplex(value(random), value(random));
  }
  r[17] = TsComplex(0, 0);
  Fill(m, L"A,1", a);
  Fill(m, L"R1,1", r);

  const Samples q = Read(m, L"A/R1,1");
  ASSERT_EQ(q.size(), static_cast<std::size_t>(kPoints));
  for (int k = 0; k < kPoints; ++k) {
    if (k == 17) continue;
    // Single-precision arithmetic: within a few float roundings of the exact quotient.
    const std::complex<double> want = Expected(a[k], r[k]);
    EXPECT_LE(std::abs(std::complex<double>(q[k].re, q[k].im) - want),
              1e-5 * std::abs(want) + 1e-30)
        << k;
  }
  EXPECT_EQ(q[17], TsComplex(0, 0));  // a zero denominator sample gives 0 + 0j, not NaN

  // Parts of a ratio follow aliases; a partial range divides only its samples.
  m.AddAlias(L"ref,1", L"R1,1");
  Samples part(kPoints, TsComplex(3, 3));
  ASSERT_TRUE(m.GetDataByName(L"A/ref,1", part, 10, 12));
  EXPECT_EQ(part[9], TsComplex(3, 3));
  EXPECT_EQ(part[10], q[10]);
  EXPECT_EQ(part[11], q[11]);
  EXPECT_EQ(part[12], TsComplex(3, 3));

  // A missing part, or a name that is no ratio, leaves the output untouched.
  Samples out{TsComplex(5, 5)};
  for (const wchar_t* name : {L"A/R2,1", L"C/R1,1", L"A/R1", L"AR1,1", L"A,1/R1", L"A/R1,2"}) {
    EXPECT_FALSE(m.GetDataByName(name, out)) << name;
  }
  EXPECT_EQ(out, Samples{TsComplex(5, 5)});
  EXPECT_EQ(m.GetDataByName(L"A/R1,1"), nullptr);  // the pointer form knows no ratios
}

TEST(DataMatrix, RatioOfUnevenBuffersCoversTheWholeNumerator) {
  DataMatrix m(2, {1, 2}, 4);
  m.AddAlias(L"num,x", L"S21");
  m.AddAlias(L"den,x", L"S11");
  ASSERT_TRUE(m.SetDataByPhysicalPort(1, 1, Samples(4, TsComplex(2, 0))));
  ASSERT_TRUE(m.SetDataByPhysicalPort(2, 1, Samples(6, TsComplex(4, 2))));
  Samples out;
  EXPECT_FALSE(m.GetDataByName(L"num/den,x", out));  // six numerator samples, four below
  ASSERT_TRUE(m.SetDataByPhysicalPort(2, 1, Samples(3, TsComplex(4, 2))));
  ASSERT_TRUE(m.GetDataByName(L"num/den,x", out));
  EXPECT_EQ(out, Samples(3, TsComplex(2, 1)));
  Samples partial(4);
  EXPECT_FALSE(m.GetDataByName(L"num/den,x", partial, 1, 4));  // past the numerator
}

TEST(DataMatrix, AuxNameFindsTheFirstBufferInNameOrder) {
  DataMatrix m(2, {1, 2}, 2);
  Fill(m, L"S21", Ramp(2, 21));
  Fill(m, L"S22", Ramp(2, 22));
  EXPECT_FALSE(m.SetAuxNameByName(L"S33", L"x"));
  ASSERT_TRUE(m.SetAuxNameByName(L"S22", L"trace"));
  ASSERT_TRUE(m.SetAuxNameByName(L"S21", L"trace"));
  Samples out;
  ASSERT_TRUE(m.GetDataByAuxName(L"trace", out));
  EXPECT_EQ(out, Ramp(2, 21));
  EXPECT_TRUE(m(1, 0).HasAuxName());
  EXPECT_EQ(m(1, 0).GetAuxName(), L"trace");

  // An empty aux name finds the first buffer that has none; storing one clears the flag.
  ASSERT_TRUE(m.SetAuxNameByName(L"S11", L"first"));
  ASSERT_TRUE(m.SetAuxNameByName(L"S12", L""));
  EXPECT_FALSE(m(0, 1).HasAuxName());
  ASSERT_TRUE(m.GetDataByAuxName(L"", out));
  EXPECT_EQ(out, Samples(2));  // S12
  EXPECT_FALSE(m.GetDataByAuxName(L"Trace", out));

  // Replacing a buffer drops its aux name.
  m.AddBuffer(L"S21");
  ASSERT_TRUE(m.GetDataByAuxName(L"trace", out));
  EXPECT_EQ(out, Ramp(2, 22));
  EXPECT_FALSE(m(1, 0).HasAuxName());
}

TEST(DataMatrix, FirstBufferComesFirstInCodeUnitOrder) {
  DataMatrix m(2, {2, 1}, 1);
  m.AddBuffer(L"S1_10");  // S11 < S12 < S1_10 < S21 < S22
  Samples out;
  ASSERT_TRUE(m.GetFirstBuffer(out));
  EXPECT_EQ(out, Samples(1));  // S11
  const std::vector<TsComplex>* first = nullptr;
  ASSERT_TRUE(m.GetFirstBuffer(&first));
  EXPECT_EQ(first, &m(1, 1).GetData());
  EXPECT_FALSE(m.GetFirstBuffer(out, 1, -1));  // start at the size

  const DataMatrix none;
  EXPECT_FALSE(none.GetFirstBuffer(out));
  EXPECT_FALSE(none.GetFirstBuffer(&first));
}

TEST(DataMatrix, CopiesAreDeepAndPointIntoTheirOwnSamples) {
  DataMatrix original(1, {1}, 2);
  original.AddAlias(L"r", L"S11");
  DataMatrix copy = original;
  Fill(original, L"S11", Ramp(2, 3));
  EXPECT_EQ(Read(copy, L"r"), Samples(2));
  EXPECT_NE(copy.GetDataByName(L"S11"), original.GetDataByName(L"S11"));
  EXPECT_EQ(copy.GetDataByName(L"S11"), copy(0, 0).GetData().data());
  copy = original;
  EXPECT_EQ(Read(copy, L"r"), Ramp(2, 3));
  EXPECT_EQ(copy.GetDataByName(L"S11"), copy(0, 0).GetData().data());
  EXPECT_TRUE(copy.HasPortMapping({1}));
}

TEST(NamedBuffer, PointerFollowsItsOwnSamplesThroughCopiesAndMoves) {
  NamedBuffer a(L"A");
  EXPECT_EQ(a.GetPointer(), nullptr);
  a.SetData(Ramp(3, 1));
  EXPECT_EQ(a.GetPointer(), a.GetData().data());

  NamedBuffer copy(a);
  EXPECT_EQ(copy.GetPointer(), copy.GetData().data());
  NamedBuffer assigned(std::wstring(L"B"));
  assigned = a;
  EXPECT_EQ(assigned.GetPointer(), assigned.GetData().data());

  NamedBuffer moved(std::move(copy));
  EXPECT_EQ(moved.GetPointer(), moved.GetData().data());
  EXPECT_EQ(copy.GetPointer(), nullptr);  // NOLINT: the moved-from state is specified
  EXPECT_EQ(copy.Size(), 0);
  assigned = std::move(moved);
  EXPECT_EQ(assigned.GetPointer(), assigned.GetData().data());
  EXPECT_EQ(moved.GetPointer(), nullptr);  // NOLINT
  a.SetData({});
  EXPECT_EQ(a.GetPointer(), nullptr);
}

}  // namespace
}  // namespace LumenUtility
