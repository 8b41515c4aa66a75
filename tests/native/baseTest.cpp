#include "base/assertions.h"
#include "base/cbHandler.h"
#include "base/iterator.h"
#include "base/prdPredicate.h"
#include "base/rcShdPtr.h"
#include "base/rcStrongPtr.h"
#include "base/rttiType.h"

#include <gtest/gtest.h>
#include <memory>
#include <string>
#include <type_traits>
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

template <typename Exception> std::string wordsOf(void (*action)())
{
    try
    {
        action();
    }
    catch (Exception const& exception)
    {
        return exception.getReason();
    }
    ADD_FAILURE() << "nothing was thrown";
    return {};
}

} // namespace

TEST(RCShdPtr, IsOneWordWide)
{
    EXPECT_EQ(sizeof(RCShdPtr<Counted>), sizeof(void*));
}

TEST(RCShdPtr, RefusesToBeGoneThroughWhileNull)
{
    RCShdPtr<Counted> const null;
    EXPECT_TRUE(null.isNull());
    EXPECT_FALSE(null);
    EXPECT_EQ(null.get(), nullptr);
    EXPECT_THROW(null->getReferenceCount(), ExNullPtr);
    EXPECT_THROW(*null, ExNullPtr);
    EXPECT_THROW(*RCStrongPtr<int>(), ExNullPtr);
    std::string const words = wordsOf<ExNullPtr>([] { *RCShdPtr<Counted>(); });
    EXPECT_NE(words.find("Counted*"), std::string::npos) << words;
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

TEST(RCShdPtr, CountsACopiedObjectAnew)
{
    int alive = 0;
    RCShdPtr<Counted> const first = makeShd<Counted>(&alive);
    RCShdPtr<Counted> const copy(new Counted(*first));
    EXPECT_EQ(first->getReferenceCount(), 1);
    EXPECT_EQ(copy->getReferenceCount(), 1);
}

TEST(RCShdPtr, CastsDownToWhatTheObjectIs)
{
    int alive = 0;
    RCShdPtr<Counted> const base = makeShd<Counted>(&alive);
    RCShdPtr<Counted> const derived = makeShd<Derived>(&alive);
    EXPECT_TRUE(dynamicCast<Derived>(base).isNull());
    EXPECT_TRUE(dynamicCast<Derived>(RCShdPtr<Counted>()).isNull());
    EXPECT_TRUE(dynamicCast<Derived>(derived) == RCShdPtr<Derived>(static_cast<Derived*>(derived.get())));
    EXPECT_EQ(derived->getReferenceCount(), 1);
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

TEST(RttiType, KnowsAClassAndWhatItDerivesFrom)
{
    struct Base
    {
        static RttiType const& getClassType() { return RttiGenType0<Base>::getInstance(); }
    };
    RttiType const& base = Base::getClassType();
    RttiType const& derived = RttiGenType1<Derived, Base>::getInstance();
    EXPECT_TRUE(base.isA(base) && derived.isA(derived) && derived.isA(base));
    EXPECT_FALSE(base.isA(derived));
    // As another library has it.
    RttiType const copy(typeid(Base), nullptr);
    EXPECT_TRUE(derived.isA(copy));
    EXPECT_FALSE(copy.isA(derived));
}

TEST(PrdPredicate, AsksTheSecondOnlyWhereTheFirstHolds)
{
    int asked = 0;
    PrdPredicate<int> const even([](int const& number) { return number % 2 == 0; });
    PrdPredicate<int> const big(
        [&asked](int const& number)
        {
            ++asked;
            return number > 10;
        });
    PrdPredicate<int> const both = even && big;
    EXPECT_TRUE(both.holds(12));
    EXPECT_FALSE(both.holds(4));
    EXPECT_FALSE(both.holds(13));
    EXPECT_EQ(asked, 2);
}

TEST(Iterator, WalksOverWhatWasThereWhenItWasMade)
{
    std::vector<int> numbers{1, 2, 3};
    Iterator<int> walk(numbers);
    numbers.clear();
    int sum = 0;
    for (int round = 0; round < 2; ++round)
        for (walk.first(); !walk.atEnd(); walk.next())
            sum += walk.item();
    EXPECT_EQ(sum, 12);
    EXPECT_EQ(walk.getCardinality(), 3);
    EXPECT_ANY_THROW(walk.item());
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
