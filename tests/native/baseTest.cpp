#include "cbHandler.h"
#include "exBase.h"
#include "iterator.h"
#include "packages/inBuildInfo.h"
#include "packages/inInit.h"
#include "pointers/plainPtr.h"
#include "pointers/rcShdPtr.h"
#include "pointers/rcWeakPtr.h"
#include "refusals.h"

#include <algorithm>
#include <gtest/gtest.h>
#include <memory>
#include <sstream>
#include <string>
#include <vector>

using namespace Kv;

namespace
{

class Counted : public RCBase<LkCounter<int>>
{
public:
    explicit Counted(int* alive) : _alive(alive) { ++*_alive; }
    Counted(Counted const& other) : RCBase(other), _alive(other._alive) { ++*_alive; }
    Counted& operator=(Counted const&) = delete;
    ~Counted() override { --*_alive; }

    RCShdPtr<Counted> next;

private:
    int* _alive;
};

class Derived : public Counted
{
public:
    using Counted::Counted;
};

} // namespace

TEST(RCShdPtr, RefusesToBeGoneThroughWhileNull)
{
    RCShdPtr<Counted> const null;
    EXPECT_TRUE(null.isNull());
    EXPECT_FALSE(null);
    EXPECT_EQ(null.get(), nullptr);
    EXPECT_THROW(null->getReferenceCount(), ExNullPtr);
    EXPECT_THROW(*null, ExNullPtr);
    EXPECT_THROW(*RCStrongPtr<int>(), ExNullPtr);
    expectContains(wordsOf<ExNullPtr>([] { *RCShdPtr<Counted>(); }), "Counted*");
}

TEST(RCShdPtr, DestroysTheObjectWithTheLastCopy)
{
    int alive = 0;
    RCShdPtr<Counted> first = makeShd<Derived>(&alive);
    RCShdPtr<Counted> second(first);
    RCShdPtr<Counted> third(std::move(first));
    EXPECT_EQ(third->getReferenceCount(), 2);
    second = second.get();
    third = third;
    EXPECT_EQ(alive, 1);
    second = nullptr;
    EXPECT_EQ(third->getReferenceCount(), 1);
    third = makeShd<Counted>(&alive);
    EXPECT_EQ(alive, 1);
    third.reset();
    EXPECT_EQ(alive, 0);
}

TEST(RCShdPtr, SurvivesAnObjectThatLetsGoOfItselfByItsOwnEnd)
{
    int alive = 0;
    RCShdPtr<Counted> head = makeShd<Counted>(&alive);
    head->next = makeShd<Counted>(&alive);
    head = head->next;
    EXPECT_EQ(alive, 1);
    head->next = head;
    Counted* const circle = head.get();
    head.reset();
    EXPECT_EQ(alive, 1);
    circle->next.reset();
    EXPECT_EQ(alive, 0);
}

TEST(RCWeakPtr, LeadsToAVirtualBaseAndBackForAsLongAsTheObjectIsThere)
{
    struct Base
    {
        virtual ~Base() = default;
        int number = 17;
    };
    struct Whole : virtual Base
    {
    };
    struct Other : virtual Base
    {
    };
    RCStrongPtr<Whole> strong = makeStrong<Whole>();
    RCWeakPtr<const Whole> const weak(strong);
    RCWeakPtr<const Base> const base(weak);
    {
        RCWeakAccessor<const Base> const accessor(base);
        strong = nullptr;
        EXPECT_FALSE(weak.isExpired()) << "the accessor holds it";
        EXPECT_EQ(accessor->number, 17);
        EXPECT_TRUE(accessor.castTo<const Whole>() == weak);
        EXPECT_THROW(accessor.castTo<const Other>(), ExCastFailed);
    }
    EXPECT_TRUE(weak.isExpired() && base.isExpired());
    EXPECT_TRUE(RCWeakPtr<const Base>(weak).isExpired()) << "converted when it is too late";
    EXPECT_THROW(RCWeakAccessor<const Base>(base)->number, ExNullPtr);
    EXPECT_THROW(RCWeakAccessor<const Base>(base).castTo<const Whole>(), ExNullPtr);
    EXPECT_THROW(*UPtr<Base>(), ExNullPtr);
}

TEST(RCShdPtr, DumpsWhatItPointsAt)
{
    struct Before
    {
        virtual ~Before() = default;
    };
    struct Behind : Before, Counted
    {
        using Counted::Counted;
    };
    static_assert(sizeof(RCShdPtr<Behind>) == sizeof(void*));
    auto const dumpOf = [](auto const& pointer)
    {
        std::ostringstream stream;
        pointer.dump(stream);
        return stream.str();
    };
    EXPECT_EQ(dumpOf(RCShdPtr<Counted>()), "Pointee type = null, T type = (anonymous namespace)::Counted, ref: 0, "
                                           "pointer:0, RCBase pointer: 0");
    int alive = 0;
    RCShdPtr<Behind> const object = makeShd<Behind>(&alive);
    RCShdPtr<Counted> const other = object;
    std::ostringstream wanted;
    wanted << ", ref: 2, pointer:" << static_cast<void*>(object.get())
           << ", RCBase pointer: " << static_cast<RCBase<LkCounter<int>>*>(object.get());
    EXPECT_NE(static_cast<void*>(object.get()), static_cast<RCBase<LkCounter<int>>*>(object.get()));
    EXPECT_NE(dumpOf(object).find(wanted.str()), std::string::npos) << dumpOf(object);
    EXPECT_NE(dumpOf(other).find("Behind, T type = (anonymous namespace)::Counted, ref: 2"), std::string::npos);
}

template <typename Exception> class Exceptions : public testing::Test
{
};

using Every = testing::Types<ExBase, ExNullPtr, ExCastFailed, ExAssertionFailed>;
TYPED_TEST_SUITE(Exceptions, Every);

TYPED_TEST(Exceptions, KeepTheirTypeAndWordsWhenAHolderOfTheBaseThrowsThem)
{
    std::unique_ptr<ExBase> const held(TypeParam("source.cpp", 17, "reason").clone());
    try
    {
        held->raise();
    }
    catch (ExBase const& thrown)
    {
        EXPECT_EQ(typeid(thrown), typeid(TypeParam));
        EXPECT_STREQ(thrown.getReason(), "reason");
        EXPECT_STREQ(thrown.what(), "reason");
        EXPECT_STREQ(thrown.getDetailedReason(), "reason (source.cpp:17)");
    }
}

TEST(Exceptions, SayWhatWentWrongInPlainWords)
{
    EXPECT_EQ(wordsOf<ExAssertionFailed>([] { Assertions::throwAssertionFailed("a.cpp", 1, "!name.empty()"); }),
              "Assertion failed: !name.empty()");
    EXPECT_EQ(wordsOf<ExCastFailed>([] { RCExUtil::throwExCastFailed(typeid(int*).name(), "plain text"); }),
              "Cannot cast int* to plain text");
}

TEST(Exceptions, LoseTheMiddleOfWordsThatAreTooLong)
{
    std::string const bad(100'000, '\xff');
    std::string const words = ExBase("source.cpp", 1, "begin " + bad + "\u00e4 end").getReason();
    EXPECT_LT(words.size(), 5 * ExBase::mostBytes);
    EXPECT_EQ(words.substr(0, 10), "begin \\xff");
    EXPECT_EQ(words.substr(words.size() - 9), "xff\u00e4 end");
    // Nothing of a character is left where the middle went.
    std::string text;
    while (text.size() < 2 * ExBase::mostBytes)
        text += "\u20ac";
    EXPECT_EQ(std::string(ExBase("source.cpp", 1, "x" + text).getReason()).find("\\x"), std::string::npos);
}

TEST(CbDataMethod, GoesOnWithDataThatIsReleasedWhileItRuns)
{
    struct Owner
    {
        using Handler = CbDataMethod<Owner, int, std::shared_ptr<std::string>>;
        void hear(int& event, std::shared_ptr<std::string> data)
        {
            handler->releaseData();
            handler = nullptr;
            ++event;
            heard.push_back(data ? *data : "nothing");
        }
        Handler* handler = nullptr;
        std::vector<std::string> heard;
    };
    Owner owner;
    auto data = std::make_shared<std::string>("kept");
    std::weak_ptr<std::string> const gone = data;
    Owner::Handler handler(&owner, &Owner::hear, std::move(data));
    int event = 0;
    for (int round = 0; round < 2; ++round)
    {
        owner.handler = &handler;
        handler.call(event);
        EXPECT_TRUE(gone.expired());
    }
    EXPECT_EQ(owner.heard, (std::vector<std::string>{"kept", "nothing"}));
    EXPECT_EQ(event, 2);
}

namespace
{

using Words = std::vector<std::string>;

Words walk(Iterator<std::string> iterator)
{
    Words words;
    for (iterator.first(); !iterator.atEnd(); iterator.next())
        words.push_back(iterator.item());
    return words;
}

} // namespace

TEST(Iterator, WalksInBothDirectionsAndNeverOutOfItsSequence)
{
    Iterator<std::string> iterator(Words{"a", "b", "c"});
    EXPECT_EQ(iterator.getCardinality(), 3);
    EXPECT_EQ(*iterator++, "a");
    EXPECT_EQ(*++iterator, "c");
    EXPECT_EQ(iterator->size(), 1U);
    iterator.end();
    EXPECT_THROW(iterator.item(), ExAssertionFailed);
    EXPECT_EQ((++iterator).getCardinality(), 3);
    EXPECT_EQ(*--iterator, "c");
    EXPECT_EQ(*iterator--, "c");
    EXPECT_FALSE(iterator.atBegin());
    EXPECT_EQ(*--iterator, "a");
    EXPECT_TRUE((--iterator).atBegin());
    iterator.last();
    EXPECT_EQ(*iterator, "c");
    Iterator<std::string> none((Words()));
    none.last();
    EXPECT_TRUE(none.atBegin() && none.atEnd());
}

TEST(Iterator, SharesItsSequenceWithCopiesUntilOneOfThemChanges)
{
    struct CountingImp : IteratorVectorImp<std::string>
    {
        CountingImp(Words items, int* clones) : IteratorVectorImp(std::move(items)), _clones(clones) {}
        RCShdPtr<IteratorImp<std::string>> clone() const override
        {
            ++*_clones;
            return makeShd<CountingImp>(*this);
        }
        int* _clones;
    };
    int clones = 0;
    Iterator<std::string> first(RCShdPtr<IteratorImp<std::string>>(new CountingImp({"a", "b"}, &clones)));
    first.next();
    Iterator<std::string> second(first);
    Iterator<std::string> const third = second;
    EXPECT_EQ(*third, "b");
    EXPECT_EQ(clones, 0);
    second.item() = "changed";
    second.first();
    EXPECT_EQ(clones, 1);
    EXPECT_EQ(third.item(), "b");
    EXPECT_EQ(walk(first), (Words{"a", "b"}));
    EXPECT_EQ(walk(second), (Words{"a", "changed"}));
    *first = "other";
    EXPECT_EQ(third.item(), "b");
    EXPECT_EQ(third->size(), 1U);
}

TEST(Iterator, WithoutAnEngineSaysSo)
{
    Iterator<std::string> null;
    EXPECT_THROW(null.atEnd(), ExNullPtr);
    EXPECT_THROW(null.first(), ExNullPtr);
    EXPECT_THROW(null++, ExNullPtr);
}

TEST(ConstIterator, LeavesItsCopiesWhereTheyAre)
{
    ConstIterator<int> iterator(std::vector<int>{1, 2});
    ConstIterator<int> const start = iterator;
    EXPECT_EQ(*++iterator, 2);
    EXPECT_EQ(*start, 1);
    EXPECT_TRUE((++iterator).atEnd());
    EXPECT_THROW(*iterator, ExAssertionFailed);
}

namespace
{

/// What has happened to the packages of a test, in order.
Words happened;

/// A package that is named by its own type and notes what becomes of it.
template <int number> class TestPackage : public InPackageInit
{
public:
    explicit TestPackage(std::vector<std::type_info const*> const& dependencies, bool hasInfo = true)
        : InPackageInit(std::to_string(number).c_str()), _hasInfo(hasInfo)
    {
        registerPackage();
        for (std::type_info const* const dependency : dependencies)
            InPackageInit::addDependency(dependency);
    }

    void initPackage() override
    {
        happened.push_back("init " + std::to_string(number));
        if (_hasInfo)
            InBuildInfoUtil::registerInfo(std::make_unique<InLibraryBuildInfo>(getName(), __DATE__));
    }

private:
    bool _hasInfo;
};

Words packagesNow()
{
    Words names;
    for (InPackageInfo const& info : InBuildInfoUtil::getInfos())
        names.push_back(info.buildInfo ? info.packageName : std::string(info.packageName) + " without information");
    return names;
}

} // namespace

TEST(Packages, AreSetUpOnceBehindThoseThatTheyDependOn)
{
    happened.clear();
    TestPackage<1> one({&typeid(TestPackage<2>), &typeid(TestPackage<9>)}, false);
    TestPackage<2> two({&typeid(TestPackage<3>)});
    {
        TestPackage<3> three({});
        EXPECT_EQ(packagesNow(), (Words{"base", "3", "2", "1 without information"})) << "9 is not loaded";
        EXPECT_EQ(happened, (Words{"init 3", "init 2", "init 1"}));
        EXPECT_EQ(two.getDependencies(), (std::vector<InVariableBase*>{&three}));
    }
    EXPECT_TRUE(two.getDependencies().empty());
    TestPackage<9> late({});
    EXPECT_EQ(packagesNow(), (Words{"base", "2", "1 without information", "9"}));
    EXPECT_EQ(happened.back(), "init 9");
    EXPECT_EQ(std::count(happened.begin(), happened.end(), "init 2"), 1);
}

TEST(Packages, ComeOutOfARingOfDependencies)
{
    happened.clear();
    TestPackage<1> one({&typeid(TestPackage<2>)});
    TestPackage<2> two({&typeid(TestPackage<3>), &typeid(TestPackage<2>)});
    TestPackage<3> three({&typeid(TestPackage<1>)});
    EXPECT_EQ(packagesNow().size(), 4U);
    EXPECT_EQ(std::count(happened.begin(), happened.end(), "init 2"), 1);
    EXPECT_EQ(happened.size(), 3U);
}

TEST(BuildInfo, IsTakenOnlyOfAPackageThatIsBeingSetUp)
{
    EXPECT_THROW(InBuildInfoUtil::registerInfo(std::make_unique<InLibraryBuildInfo>("nowhere", __DATE__)), ExBase);
    EXPECT_THROW(InBuildInfoUtil::registerInfo(nullptr), ExNullPtr);
}

TEST(ApplicationMode, IsOneUntilTheApplicationSaysOtherwise)
{
    EXPECT_EQ(static_cast<int>(InBuildInfoUtil::getApplicationMode()), 1);
    InBuildInfoUtil::setApplicationMode(ApplicationModes::Interactive);
    EXPECT_EQ(InBuildInfoUtil::getApplicationMode(), ApplicationModes::Interactive);
    InBuildInfoUtil::setApplicationMode(ApplicationModes::NonInteractive);
}
