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

using Log = std::vector<std::string>;

// Records its own destruction so a test can see the last release.
class Tracked : public test::Thing {
public:
    Tracked(Log* log, std::string name) : log_(log), name_(std::move(name)) {}
    ~Tracked() override { log_->push_back(name_); }
    std::string objectName() const override { return name_; }

private:
    Log* log_;
    std::string name_;
};

TEST(Ref, CopiesCountAndTheLastReleaseDestroys)
{
    Log log;
    const long before = RefCounted::liveObjects();
    Ref<Tracked> a = makeRef<Tracked>(&log, "a");
    EXPECT_EQ(RefCounted::liveObjects(), before + 1);
    {
        Ref<Tracked> b = a;
        EXPECT_EQ(a->refCount(), 2u);
    }
    EXPECT_EQ(a->refCount(), 1u);
    EXPECT_TRUE(log.empty());
    a.reset();
    EXPECT_EQ(log, Log{"a"});
    EXPECT_FALSE(a);
    EXPECT_EQ(RefCounted::liveObjects(), before);
}

TEST(Ref, StoringANewObjectOrNothingReleasesTheOldOne)
{
    Log log;
    Ref<Tracked> name = makeRef<Tracked>(&log, "first");
    name = makeRef<Tracked>(&log, "second");
    EXPECT_EQ(log, Log{"first"});
    EXPECT_EQ(name->objectName(), "second");
    EXPECT_EQ(name->refCount(), 1u);
    name = nullptr;
    EXPECT_EQ(log, (Log{"first", "second"}));
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

TEST(Ref, MovingTransfersWithoutCountingAndABaseReferenceCounts)
{
    Log log;
    Ref<Tracked> a = makeRef<Tracked>(&log, "moved");
    Ref<Tracked> b = std::move(a);
    EXPECT_FALSE(a);  // NOLINT: the moved-from state is part of the contract
    EXPECT_EQ(b->refCount(), 1u);
    Ref<Object> base = b;
    EXPECT_EQ(b->refCount(), 2u);
    EXPECT_EQ(base.get(), b.get());
}

// ---- objects held in Variants ---------------------------------------------------------------

TEST(VariantObject, StoringAnotherObjectOrValueReleasesTheOldOne)
{
    Log log;
    Variant v(makeRef<Tracked>(&log, "old"));
    v = Variant(makeRef<Tracked>(&log, "new"));
    EXPECT_EQ(log, Log{"old"});
    EXPECT_EQ(v.object()->objectName(), "new");
    v = 1.0;
    EXPECT_EQ(log, (Log{"old", "new"}));
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
