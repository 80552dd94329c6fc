// SPDX-License-Identifier: Apache-2.0
// The service's metadata filters, its metadata replies, and opaque requests.
#include <binder/Parcel.h>

#include <future>
#include <memory>

#include "MutexProbe.h"
#include "ParcelFailure.h"
#include "PrivateMember.h"
#include "ServiceFixture.h"

namespace orvtest {

using android::OrvMediaService;

ORV_OPEN_MEMBER(AllowSet, OrvMediaService, mMetadataAllow);
ORV_OPEN_MEMBER(DropSet, OrvMediaService, mMetadataDrop);
ORV_OPEN_MEMBER(UpdatedSet, OrvMediaService, mMetadataUpdated);
ORV_OPEN_MEMBER(MetadataLock, OrvMediaService, mMetadataLock);

namespace {

using android::Parcel;
using android::SortedVector;
using testing::ElementsAre;
using Codes = std::vector<int32_t>;

const int32_t kMetadataMarker = 'M' << 24 | 'E' << 16 | 'T' << 8 | 'A';

Parcel parcelOf(const std::vector<int32_t>& words) {
    Parcel parcel;
    for (int32_t word : words) parcel.writeInt32(word);
    parcel.setDataPosition(0);
    return parcel;
}

Parcel filterOf(const Codes& allow, const Codes& block) {
    std::vector<int32_t> words = {static_cast<int32_t>(allow.size())};
    words.insert(words.end(), allow.begin(), allow.end());
    words.push_back(static_cast<int32_t>(block.size()));
    words.insert(words.end(), block.begin(), block.end());
    return parcelOf(words);
}

Codes wordsOf(const Parcel& parcel) {
    Codes words(parcel.dataSize() / sizeof(int32_t));
    parcel.setDataPosition(0);
    parcel.read(words.data(), words.size() * sizeof(int32_t));
    return words;
}

class MetadataFilterTest : public ServiceFixture {
protected:
    Codes allowed() { return codesOf(service.get()->*memberOf(AllowSet{})); }
    Codes dropped() { return codesOf(service.get()->*memberOf(DropSet{})); }

    // Filters that a failing parcel must leave alone.
    void setSomeFilters() {
        ASSERT_EQ(service->setMetadataFilter(filterOf({7}, {8})), android::NO_ERROR);
        log.clear();
    }
    void expectSomeFilters() {
        EXPECT_THAT(allowed(), ElementsAre(7));
        EXPECT_THAT(dropped(), ElementsAre(8));
    }

    const ExpectedLine filterEntry = debug("OrvMediaService::setMetadataFilter():");
    const ExpectedLine metadataEntry = debug("OrvMediaService::getMetadata(): not implement");

private:
    static Codes codesOf(const SortedVector<int>& set) {
        return Codes(set.array(), set.array() + set.size());
    }
};

TEST_F(MetadataFilterTest, SetsAreSortedWithoutDuplicates) {
    EXPECT_EQ(service->setMetadataFilter(filterOf({5, 5, 2}, {9, -1, 9})), android::NO_ERROR);
    EXPECT_THAT(allowed(), ElementsAre(2, 5));
    EXPECT_THAT(dropped(), ElementsAre(-1, 9));
    EXPECT_THAT(log.take(), LinesAre({filterEntry.tagged("OrvMediaService")}));
}

TEST_F(MetadataFilterTest, NewFiltersReplaceTheEarlierOnes) {
    setSomeFilters();
    EXPECT_EQ(service->setMetadataFilter(filterOf({}, {})), android::NO_ERROR);
    EXPECT_TRUE(allowed().empty());
    EXPECT_TRUE(dropped().empty());
}

TEST_F(MetadataFilterTest, SixtyFourCodesAreAccepted) {
    Codes codes;
    for (int32_t i = 64; i > 0; i--) codes.push_back(i);
    EXPECT_EQ(service->setMetadataFilter(filterOf(codes, codes)), android::NO_ERROR);
    EXPECT_EQ(allowed().size(), 64u);
    EXPECT_EQ(dropped().size(), 64u);
}

TEST_F(MetadataFilterTest, CodesAreReadFromAnyByteOn) {
    const uint8_t bytes[] = {9, 1, 0, 0, 0, 7, 1, 0, 0, 1, 0, 0, 0, 8, 0, 0, 0};
    Parcel parcel;
    parcel.setData(bytes, sizeof(bytes));
    parcel.setDataPosition(1);
    EXPECT_EQ(service->setMetadataFilter(parcel), android::NO_ERROR);
    EXPECT_THAT(allowed(), ElementsAre(0x107));
    EXPECT_THAT(dropped(), ElementsAre(8));
}

// A parcel that is refused, in which words it has.
struct BadFilter {
    const char* name;
    std::vector<int32_t> words;
    int status;
    std::vector<const char*> errors;
};
void PrintTo(const BadFilter& filter, std::ostream* out) { *out << filter.name; }

class BadFilterTest : public MetadataFilterTest, public testing::WithParamInterface<BadFilter> {};

TEST_P(BadFilterTest, LeavesBothSetsAsTheyWere) {
    setSomeFilters();
    EXPECT_EQ(service->setMetadataFilter(parcelOf(GetParam().words)), GetParam().status);
    expectSomeFilters();
    std::vector<ExpectedLine> lines = {filterEntry};
    for (const char* text : GetParam().errors) lines.push_back(error(text));
    EXPECT_THAT(log.take(), LinesAre(lines));
}

INSTANTIATE_TEST_SUITE_P(
    Parcels, BadFilterTest,
    testing::Values(
        BadFilter{"Empty", {}, android::NOT_ENOUGH_DATA, {"Failed to read filter's length"}},
        BadFilter{"AllowCount65", {65}, android::BAD_VALUE, {"Invalid filter len 65"}},
        BadFilter{"AllowCountNegative", {-1, 1}, android::BAD_VALUE, {"Invalid filter len -1"}},
        BadFilter{"AllowCodesCutOff", {3, 1, 2}, android::NOT_ENOUGH_DATA, {}},
        BadFilter{"BlockCountMissing",
                  {1, 2},
                  android::NOT_ENOUGH_DATA,
                  {"Failed to read filter's length"}},
        BadFilter{"BlockCount65", {1, 2, 65}, android::BAD_VALUE, {"Invalid filter len 65"}},
        BadFilter{"BlockCodesCutOff", {1, 2, 2, 3}, android::NOT_ENOUGH_DATA, {}}),
    [](const auto& info) { return info.param.name; });

TEST_F(MetadataFilterTest, FiltersAreSetWithoutTheLock) {
    std::future<int> set;  // outlives the lock, for it waits when it goes
    android::Mutex::Autolock held(service.get()->*memberOf(MetadataLock{}));
    set = std::async(std::launch::async,
                     [&] { return service->setMetadataFilter(filterOf({1}, {})); });
    EXPECT_EQ(set.wait_for(std::chrono::seconds(10)), std::future_status::ready);
}

TEST_F(MetadataFilterTest, UpdatesAndTheFiltersReadersWaitForTheLock) {
    attachPlayer();
    Parcel reply;
    const std::pair<const char*, std::function<void()>> operations[] = {
        {"getMetadata", [&] { service->getMetadata(true, false, &reply); }},
        {"shouldDropMetadata", [&] { service->shouldDropMetadata(1); }},
        {"addNewMetadataUpdate", [&] { service->addNewMetadataUpdate(1); }},
    };
    for (const auto& [name, operation] : operations) {
        SCOPED_TRACE(name);
        std::unique_ptr<OtherThread> other;
        {
            android::Mutex::Autolock held(service.get()->*memberOf(MetadataLock{}));
            other = std::make_unique<OtherThread>(operation);
            EXPECT_TRUE(other->isStopped());
        }
        other->join();
    }
}

// Waiting is not enough: what they do before it would not be guarded.
TEST_F(MetadataFilterTest, TheSetsAreNotTouchedBeforeTheLockIsTaken) {
    attachPlayer();
    SortedVector<int>& updated = service.get()->*memberOf(UpdatedSet{});
    SortedVector<int>& dropping = service.get()->*memberOf(DropSet{});
    Parcel reply;
    bool isDropped = true;
    std::unique_ptr<OtherThread> getting, asking, adding;
    {
        android::Mutex::Autolock held(service.get()->*memberOf(MetadataLock{}));
        dropping.add(5);
        getting = std::make_unique<OtherThread>([&] { service->getMetadata(true, false, &reply); });
        asking = std::make_unique<OtherThread>([&] { isDropped = service->shouldDropMetadata(5); });
        EXPECT_TRUE(getting->isStopped());
        EXPECT_TRUE(asking->isStopped());
        updated.add(7);
        dropping.clear();
    }
    getting->join();
    asking->join();
    EXPECT_FALSE(isDropped);
    EXPECT_THAT(engine->calls(), ElementsAre("getMetadata({7})"));
    {
        android::Mutex::Autolock held(service.get()->*memberOf(MetadataLock{}));
        adding = std::make_unique<OtherThread>([&] { service->addNewMetadataUpdate(9); });
        EXPECT_TRUE(adding->isStopped());
        EXPECT_TRUE(updated.isEmpty());
    }
    adding->join();
    EXPECT_FALSE(updated.isEmpty());
}

TEST_F(MetadataFilterTest, ParcelWithoutItsBytesIsABadValue) {
    setSomeFilters();
    const ParcelFailure failure;
    EXPECT_EQ(service->setMetadataFilter(filterOf({1}, {2})), android::BAD_VALUE);
    expectSomeFilters();
    EXPECT_THAT(log.take(), LinesAre({filterEntry, error("Filter had no data")}));
}

// Whether a code is dropped under a pair of filters.
struct DropCase {
    Codes allow;
    Codes block;
    int code;
    bool dropped;
};
void PrintTo(const DropCase& one, std::ostream* out) {
    *out << one.code << (one.dropped ? " is dropped" : " is kept");
}

class ShouldDropTest : public ServiceFixture, public testing::WithParamInterface<DropCase> {};

TEST_P(ShouldDropTest, BlockSetGoesBeforeAllowSet) {
    const DropCase& param = GetParam();
    service->setMetadataFilter(filterOf(param.allow, param.block));
    EXPECT_EQ(service->shouldDropMetadata(param.code), param.dropped);
}

INSTANTIATE_TEST_SUITE_P(
    Filters, ShouldDropTest,
    testing::Values(DropCase{{}, {}, 5, false}, DropCase{{}, {}, 0, false},
                    DropCase{{5}, {}, 5, false}, DropCase{{5}, {}, 6, true},
                    DropCase{{5}, {}, 0, true}, DropCase{{}, {5}, 5, true},
                    DropCase{{}, {5}, 6, false}, DropCase{{5}, {5}, 5, true},
                    DropCase{{0}, {}, 77, false}, DropCase{{0, 9}, {}, 77, false},
                    DropCase{{}, {0}, 77, true}, DropCase{{77}, {0}, 77, true},
                    // A smaller code than 0 stands first, and 0 is then a code like any other.
                    DropCase{{-1, 0}, {}, 77, true}));

TEST_F(MetadataFilterTest, MetadataWithoutPlayerLeavesTheReply) {
    Parcel reply;
    EXPECT_EQ(service->getMetadata(true, true, &reply), android::NO_INIT);
    EXPECT_EQ(reply.dataSize(), 0u);
    EXPECT_THAT(log.take(),
                LinesAre({metadataEntry, error("OrvMediaService::getMetadata(): NO_INIT")}));
}

TEST_F(MetadataFilterTest, MetadataWithoutPlayerKeepsTheUpdates) {
    service->addNewMetadataUpdate(3);
    Parcel reply;
    service->getMetadata(true, false, &reply);
    attachPlayer();
    service->getMetadata(true, false, &reply);
    EXPECT_THAT(engine->calls(), ElementsAre("getMetadata({3})"));
}

TEST_F(MetadataFilterTest, EngineRecordsStandUnderTheHeader) {
    attachPlayer();
    engine->reply("getMetadata", {16, 25, 2, 3});
    Parcel reply;
    EXPECT_EQ(service->getMetadata(false, true, &reply), android::NO_ERROR);
    EXPECT_THAT(wordsOf(reply), ElementsAre(-1, 24, kMetadataMarker, 16, 25, 2, 3));
    EXPECT_THAT(engine->calls(), ElementsAre("getMetadata({})"));
    EXPECT_THAT(log.take(), LinesAre({metadataEntry}));
}

TEST_F(MetadataFilterTest, FailingEngineLeavesOnlyThePlaceholder) {
    attachPlayer();
    engine->reply("getMetadata", {16, 25, 2, 3});
    engine->answer("getMetadata", {-1010});
    Parcel reply;
    EXPECT_EQ(service->getMetadata(false, false, &reply), -1010);
    EXPECT_THAT(wordsOf(reply), ElementsAre(-1));
    EXPECT_THAT(log.take(),
                LinesAre({metadataEntry,
                          error("OrvMediaService::getMetadata(): getMetadata failed -1010")}));
}

TEST_F(MetadataFilterTest, ReplyGoesOnBehindWhatTheParcelHolds) {
    attachPlayer();
    Parcel reply;
    reply.writeInt32(123);
    service->getMetadata(false, false, &reply);
    EXPECT_THAT(wordsOf(reply), ElementsAre(123, -1, 8, kMetadataMarker));
}

TEST_F(MetadataFilterTest, UpdatesAreAskedForOnceAndSorted) {
    attachPlayer();
    for (int code : {9, 3, 3}) service->addNewMetadataUpdate(code);
    Parcel reply;
    service->getMetadata(true, false, &reply);
    service->getMetadata(true, false, &reply);
    EXPECT_THAT(engine->calls(), ElementsAre("getMetadata({3, 9})", "getMetadata({})"));
}

TEST_F(MetadataFilterTest, AskingForEverythingForgetsTheUpdatesToo) {
    attachPlayer();
    service->addNewMetadataUpdate(3);
    Parcel reply;
    service->getMetadata(false, false, &reply);
    service->getMetadata(true, false, &reply);
    EXPECT_THAT(engine->calls(), ElementsAre("getMetadata({})", "getMetadata({})"));
}

TEST_F(MetadataFilterTest, UpdatesAreForgottenEvenWhenTheEngineFails) {
    attachPlayer();
    engine->answer("getMetadata", {-1, 0});
    service->addNewMetadataUpdate(3);
    Parcel reply;
    service->getMetadata(true, false, &reply);
    service->getMetadata(true, false, &reply);
    EXPECT_THAT(engine->calls(), ElementsAre("getMetadata({3})", "getMetadata({})"));
}

TEST_F(MetadataFilterTest, FilterFlagChangesNothing) {
    attachPlayer();
    service->setMetadataFilter(filterOf({1}, {2}));
    for (int code : {1, 2}) service->addNewMetadataUpdate(code);
    engine->reply("getMetadata", {42});
    Parcel reply;
    service->getMetadata(true, true, &reply);
    EXPECT_THAT(engine->calls(), ElementsAre("getMetadata({1, 2})"));
    EXPECT_THAT(wordsOf(reply), ElementsAre(-1, 12, kMetadataMarker, 42));
}

TEST_F(MetadataFilterTest, LockIsFreeWhileTheEngineIsAsked) {
    attachPlayer();
    std::future<void> update;
    engine->whenCalled("getMetadata", [&] {
        update = std::async(std::launch::async, [&] { service->addNewMetadataUpdate(4); });
        EXPECT_EQ(update.wait_for(std::chrono::seconds(10)), std::future_status::ready);
    });
    Parcel reply;
    service->getMetadata(true, false, &reply);
    engine->whenCalled("getMetadata", [] {});
    service->getMetadata(true, false, &reply);
    EXPECT_THAT(engine->calls(), ElementsAre("getMetadata({})", "getMetadata({4})"));
}

TEST_F(MetadataFilterTest, InvokePassesTheParcelsThrough) {
    attachPlayer();
    engine->reply("invoke", {6});
    engine->answer("invoke", {-38});
    Parcel reply;
    EXPECT_EQ(service->invoke(parcelOf({1, 2}), &reply), -38);
    EXPECT_THAT(engine->calls(), ElementsAre("invoke([1, 2])"));
    EXPECT_THAT(wordsOf(reply), ElementsAre(6));
    EXPECT_THAT(log.take(), LinesAre({info("OrvMediaService::invoke()")}));
}

TEST_F(MetadataFilterTest, InvokeWithoutPlayerLeavesTheReply) {
    Parcel reply;
    EXPECT_EQ(service->invoke(parcelOf({1, 2}), &reply), android::NO_INIT);
    EXPECT_EQ(reply.dataSize(), 0u);
    EXPECT_THAT(log.take(), LinesAre({info("OrvMediaService::invoke()"),
                                      error("OrvMediaService::invoke(): NO_INIT")}));
}

}  // namespace
}  // namespace orvtest
