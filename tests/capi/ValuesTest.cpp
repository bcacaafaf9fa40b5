// KGVariant and KGArray: what a host relies on when it fills arguments and reads results.
#include <cstring>

#include "capi/CapiSupport.h"
#include "capi/HostForm.h"

namespace {

using namespace capi_test;

struct Bounds {
    const char* name;
    int32_t lo0, hi0, lo1, hi1;
    bool made;
};

class ArrayCreateTest : public ::testing::TestWithParam<Bounds> {};

TEST_P(ArrayCreateTest, MakesArraysWithTheirBoundsOrNone)
{
    const Bounds& b = GetParam();
    KGArray* a = KGArrayCreate(b.lo0, b.hi0, b.lo1, b.hi1);
    ASSERT_EQ(a != nullptr, b.made);
    if (!a) return;
    int32_t lo = 0, hi = 0;
    ASSERT_EQ(KGArrayBounds(a, 0, &lo, &hi), KG_S_OK);
    EXPECT_EQ(lo, b.lo0);
    EXPECT_EQ(hi, b.hi0);
    ASSERT_EQ(KGArrayBounds(a, 1, &lo, &hi), KG_S_OK);
    EXPECT_EQ(lo, b.lo1);
    EXPECT_EQ(hi, b.hi1);
    EXPECT_EQ(KGArrayBounds(a, 2, &lo, &hi), KG_E_INVALIDARG);
    Var corner;
    ASSERT_EQ(KGArrayGet(a, b.hi0, b.hi1, &corner.v), KG_S_OK);
    EXPECT_EQ(corner.v.vt, KG_VT_EMPTY);
    EXPECT_EQ(KGArrayGet(a, b.hi0 + 1, b.hi1, &corner.v), KG_E_BADINDEX);
    EXPECT_EQ(KGArrayGet(a, b.lo0, b.lo1 - 1, &corner.v), KG_E_BADINDEX);
    KGArrayDestroy(a);
}

INSTANTIATE_TEST_SUITE_P(Cases, ArrayCreateTest,
                         ::testing::Values(Bounds{"ValueTable", 0, 2, 0, 12, true},
                                           Bounds{"OneCell", 0, 0, 0, 0, true},
                                           Bounds{"NegativeLowerBounds", -2, 0, -1, 1, true},
                                           Bounds{"UpperBelowLower", 0, -1, 0, 3, false},
                                           Bounds{"SecondUpperBelowLower", 0, 3, 5, 4, false},
                                           Bounds{"TooLargeToMean", 0, 100000, 0, 100000, false}),
                         byName);

TEST(VariantTest, CopyOfAStringIsItsOwn)
{
    Var a, b;
    ASSERT_EQ(KGVariantSetString(&a.v, "Agent A"), KG_S_OK);
    ASSERT_EQ(KGVariantCopy(&b.v, &a.v), KG_S_OK);
    ASSERT_EQ(b.v.vt, KG_VT_STRING);
    EXPECT_NE(b.v.strVal, a.v.strVal);
    KGVariantClear(&a.v);
    EXPECT_STREQ(b.v.strVal, "Agent A");
}

TEST(VariantTest, NullStringReadsAsEmptyText)
{
    Var a;
    ASSERT_EQ(KGVariantSetString(&a.v, nullptr), KG_S_OK);
    ASSERT_EQ(a.v.vt, KG_VT_STRING);
    EXPECT_STREQ(a.v.strVal, "");
}

TEST(VariantTest, CopyOfAnArrayIsDeep)
{
    Var a, b, cell;
    a.v.vt = KG_VT_ARRAY;
    a.v.arrVal = KGArrayCreate(0, 1, 0, 1);
    ASSERT_EQ(KGVariantSetString(&cell.v, "Jan"), KG_S_OK);
    ASSERT_EQ(KGArrayPut(a.v.arrVal, 0, 1, &cell.v), KG_S_OK);
    ASSERT_EQ(KGVariantCopy(&b.v, &a.v), KG_S_OK);
    setLong(cell.v, 5);
    ASSERT_EQ(KGArrayPut(a.v.arrVal, 0, 1, &cell.v), KG_S_OK);  // the original changes, the copy does not
    Var read;
    ASSERT_EQ(KGArrayGet(b.v.arrVal, 0, 1, &read.v), KG_S_OK);
    ASSERT_EQ(read.v.vt, KG_VT_STRING);
    EXPECT_STREQ(read.v.strVal, "Jan");
}

TEST(VariantTest, ObjectsAreSharedWithAReferenceEach)
{
    HostLog log;
    KGObject* form = makeHostForm(log, 1, 1, 1, nullptr);
    {
        Var a, b;
        ASSERT_EQ(KGVariantSetObject(&a.v, form), KG_S_OK);
        ASSERT_EQ(KGVariantCopy(&b.v, &a.v), KG_S_OK);
        EXPECT_EQ(b.v.objVal, form);
        ASSERT_EQ(KGVariantSetObject(&a.v, a.v.objVal), KG_S_OK);  // storing what it holds keeps it alive
        KGRelease(form);
        EXPECT_EQ(log.alive, 2);
    }
    EXPECT_EQ(log.alive, 0);
}

TEST(VariantTest, UnknownTypeIsNotCopied)
{
    KGVariant bad;
    KGVariantInit(&bad);
    bad.vt = 77;
    Var dest;
    ASSERT_EQ(KGVariantSetString(&dest.v, "old"), KG_S_OK);
    EXPECT_EQ(KGVariantCopy(&dest.v, &bad), KG_E_BADVARTYPE);
    EXPECT_EQ(dest.v.vt, KG_VT_EMPTY);
}

TEST(ErrorInfoTest, LongDescriptionsAreCutAtACharacterBoundary)
{
    // A form file name of many two-byte characters: the description is longer than its buffer.
    std::string name;
    for (int i = 0; i < 700; ++i) name += "\xC3\xA9";  // é
    KGObject* form = nullptr;
    KGErrorInfo err;
    ASSERT_EQ(KGLoadFormFile(("/nonexistent/" + name + ".json").c_str(), &form, &err), KG_E_EXCEPTION);
    EXPECT_EQ(form, nullptr);
    EXPECT_EQ(err.number, 53);  // file not found, as the test stand's form loader numbers it
    const size_t n = std::strlen(err.description);
    EXPECT_LT(n, sizeof err.description);
    EXPECT_GT(n, 1000u);
    // The text ends on a whole character: not on the first byte of a two-byte one.
    EXPECT_NE(static_cast<unsigned char>(err.description[n - 1]), 0xC3);
}

}  // namespace
