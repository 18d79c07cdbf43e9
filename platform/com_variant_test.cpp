#include "lumen/platform/com_variant.h"

#include <gtest/gtest.h>

#include <new>
#include <string>

#include "lumen/platform/ole_exception.h"

namespace {

using LumenUtility::DISP_E_TYPEMISMATCH;
using LumenUtility::E_INVALIDARG;
using LumenUtility::S_OK;

// The HRESULT of the COleException that `read` throws, or S_OK when it throws none.
template <typename Read>
HRESULT OleErrorOf(Read read) {
  try {
    read();
  } catch (const COleException& e) {
    return e.m_sc;
  }
  return S_OK;
}

TEST(CComVariant, EachKindKeepsItsValueAndRefusesOtherKinds) {
  const CComVariant empty, i4(-7), r8(2.5), yes(true), no(false), text(L"Power"),
      none(static_cast<const wchar_t*>(nullptr));
  EXPECT_EQ(empty.GetType(), VT_EMPTY);
  EXPECT_EQ(i4.GetType(), VT_I4);
  EXPECT_EQ(i4.GetLong(), -7);
  EXPECT_EQ(r8.GetType(), VT_R8);
  EXPECT_EQ(r8.GetDouble(), 2.5);
  EXPECT_EQ(yes.GetType(), VT_BOOL);
  EXPECT_TRUE(yes.GetBool());
  EXPECT_FALSE(no.GetBool());
  EXPECT_EQ(text.GetType(), VT_BSTR);
  EXPECT_EQ(text.GetString(), L"Power");
  EXPECT_EQ(none.GetString(), L"");  // a null text is an empty string

  EXPECT_EQ(OleErrorOf([&] { i4.GetDouble(); }), DISP_E_TYPEMISMATCH);
  EXPECT_EQ(OleErrorOf([&] { empty.GetBool(); }), DISP_E_TYPEMISMATCH);
}

TEST(CComVariant, ReferencesReadTheirTargetAndCopyIndTakesTheValueAtThatMoment) {
  std::int32_t count = 4;
  double level = -10.5;
  VARIANT_BOOL on = VARIANT_TRUE;
  std::wstring name = L"Port 1";
  const CComVariant refs[] = {CComVariant::Reference(&count), CComVariant::Reference(&level),
                              CComVariant::Reference(&on), CComVariant::Reference(&name)};
  const CComVariant values[] = {CComVariant(4), CComVariant(-10.5), CComVariant(true),
                                CComVariant(L"Port 1")};
  CComVariant copies[4];
  for (int i = 0; i < 4; ++i) {
    EXPECT_EQ(refs[i].GetType(), values[i].GetType() | VT_BYREF);
    ASSERT_EQ(VariantCopyInd(&copies[i], &refs[i]), S_OK);
    EXPECT_EQ(copies[i], values[i]) << i;
  }
  count = 5, level = 0, on = VARIANT_FALSE, name = L"Port 2";
  EXPECT_EQ(refs[0].GetLong(), 5);
  EXPECT_EQ(refs[1].GetDouble(), 0.0);
  EXPECT_FALSE(refs[2].GetBool());
  EXPECT_EQ(refs[3].GetString(), L"Port 2");
  for (int i = 0; i < 4; ++i) EXPECT_EQ(copies[i], values[i]) << i;  // copies stand alone
  EXPECT_FALSE(refs[0] == CComVariant(5));  // a reference equals only the same reference
  EXPECT_EQ(refs[0], CComVariant::Reference(&count));

  // By-value variants copy as they are, and a variant dereferences in place.
  CComVariant same = CComVariant::Reference(&count);
  ASSERT_EQ(VariantCopyInd(&same, &same), S_OK);
  EXPECT_EQ(same, CComVariant(5));
  ASSERT_EQ(VariantCopyInd(&same, &values[3]), S_OK);
  EXPECT_EQ(same, CComVariant(L"Port 1"));
}

TEST(CComVariant, NullReferencesAndPointersAreInvalidArgumentsThatChangeNothing) {
  const CComVariant dangling = CComVariant::Reference(static_cast<double*>(nullptr));
  CComVariant dest(9);
  EXPECT_EQ(VariantCopyInd(&dest, &dangling), E_INVALIDARG);
  EXPECT_EQ(VariantCopyInd(nullptr, &dest), E_INVALIDARG);
  EXPECT_EQ(VariantCopyInd(&dest, nullptr), E_INVALIDARG);
  EXPECT_EQ(dest, CComVariant(9));
  EXPECT_EQ(OleErrorOf([&] { dangling.GetDouble(); }), E_INVALIDARG);
  EXPECT_EQ(OleErrorOf([&] { dangling.GetLong(); }), DISP_E_TYPEMISMATCH);
}

TEST(AfxCheckError, RaisesOutOfMemoryAsBadAllocAndOtherFailuresAsOleExceptions) {
  AfxCheckError(S_OK);
  AfxCheckError(LumenUtility::S_FALSE);
  EXPECT_THROW(AfxCheckError(LumenUtility::E_OUTOFMEMORY), std::bad_alloc);
  EXPECT_EQ(OleErrorOf([] { AfxCheckError(E_INVALIDARG); }), E_INVALIDARG);
  EXPECT_STREQ(COleException(LumenUtility::E_FAIL).what(), "OLE error 0x80004005");
}

}  // namespace
