// Counted references: storing a new object into a name releases the one it held.
#include <string>
#include <utility>
#include <vector>

#include "RowSupport.h"
#include "core/Dispatch.h"
#include "core/Ref.h"
#include "core/Variant.h"

namespace kg {
namespace {

// Records its own destruction so a test can see the last release.
class Tracked : public TableObject {
public:
    explicit Tracked(std::vector<std::string>* log, std::string name) : log_(log), name_(std::move(name)) {}
    ~Tracked() override { log_->push_back(name_); }
    Variant invoke(DispId, uint16_t, Args&) override { return {}; }
    std::string objectName() const override { return name_; }

protected:
    const std::vector<MemberInfo>& members() const override
    {
        static const std::vector<MemberInfo> none;
        return none;
    }

private:
    std::vector<std::string>* log_;
    std::string name_;
};

using Log = std::vector<std::string>;

TEST(Ref, NewObjectStartsWithOneReference)
{
    Log log;
    Ref<Tracked> a = makeRef<Tracked>(&log, "a");
    EXPECT_EQ(a->refCount(), 1u);
}

TEST(Ref, CopiesCountAndTheLastReleaseDestroys)
{
    Log log;
    Ref<Tracked> a = makeRef<Tracked>(&log, "a");
    {
        Ref<Tracked> b = a;
        EXPECT_EQ(a->refCount(), 2u);
    }
    EXPECT_EQ(a->refCount(), 1u);
    EXPECT_TRUE(log.empty());
    a.reset();
    EXPECT_EQ(log, Log{"a"});
    EXPECT_FALSE(a);
}

TEST(Ref, StoringANewObjectReleasesTheOldOne)
{
    Log log;
    Ref<Tracked> name = makeRef<Tracked>(&log, "first");
    name = makeRef<Tracked>(&log, "second");
    EXPECT_EQ(log, Log{"first"});
    EXPECT_EQ(name->objectName(), "second");
    EXPECT_EQ(name->refCount(), 1u);
}

TEST(Ref, StoringNothingReleases)
{
    Log log;
    Ref<Tracked> name = makeRef<Tracked>(&log, "only");
    name = nullptr;
    EXPECT_EQ(log, Log{"only"});
}

TEST(Ref, SelfAssignmentKeepsTheObject)
{
    Log log;
    Ref<Tracked> name = makeRef<Tracked>(&log, "self");
    const Ref<Tracked>& same = name;
    name = same;
    EXPECT_TRUE(log.empty());
    EXPECT_EQ(name->refCount(), 1u);
}

TEST(Ref, MovingTransfersWithoutCounting)
{
    Log log;
    Ref<Tracked> a = makeRef<Tracked>(&log, "moved");
    Ref<Tracked> b = std::move(a);
    EXPECT_FALSE(a);  // NOLINT: the moved-from state is part of the contract
    EXPECT_EQ(b->refCount(), 1u);
}

TEST(Ref, ConvertsToABaseReferenceAndCounts)
{
    Log log;
    Ref<Tracked> a = makeRef<Tracked>(&log, "derived");
    Ref<Object> base = a;
    EXPECT_EQ(a->refCount(), 2u);
    EXPECT_EQ(base.get(), a.get());
}

TEST(Ref, LiveObjectsCountsCreationAndDestruction)
{
    Log log;
    const long before = RefCounted::liveObjects();
    Ref<Tracked> a = makeRef<Tracked>(&log, "a");
    Ref<Tracked> b = makeRef<Tracked>(&log, "b");
    EXPECT_EQ(RefCounted::liveObjects(), before + 2);
    a.reset();
    b.reset();
    EXPECT_EQ(RefCounted::liveObjects(), before);
}

// ---- objects held in Variants ---------------------------------------------------------------

TEST(VariantObject, CopyingTheValueSharesTheObject)
{
    Log log;
    Ref<Tracked> a = makeRef<Tracked>(&log, "shared");
    Variant v(a);
    Variant w = v;
    EXPECT_EQ(a->refCount(), 3u);
    EXPECT_EQ(w.object(), a.get());
}

TEST(VariantObject, StoringAnotherValueReleasesTheObject)
{
    Log log;
    Variant v(makeRef<Tracked>(&log, "held"));
    v = 1.0;
    EXPECT_EQ(log, Log{"held"});
}

TEST(VariantObject, StoringAnotherObjectReleasesTheOldOne)
{
    Log log;
    Variant v(makeRef<Tracked>(&log, "old"));
    v = Variant(makeRef<Tracked>(&log, "new"));
    EXPECT_EQ(log, Log{"old"});
    EXPECT_EQ(v.object()->objectName(), "new");
}

TEST(VariantObject, ObjectsInAnArrayAreReleasedWithIt)
{
    Log log;
    {
        Variant table(VariantArray(0, 1, 0, 1));
        table.array().at(0, 0) = Variant(makeRef<Tracked>(&log, "cell"));
        Variant copy = table;
        EXPECT_EQ(table.array().at(0, 0).object()->refCount(), 2u);
        table.array().redim(0, 0);
        EXPECT_TRUE(log.empty()) << "the copy still holds the object";
    }
    EXPECT_EQ(log, Log{"cell"});
}

}  // namespace
}  // namespace kg
