// SPDX-License-Identifier: Apache-2.0
// The mutexes that are there before anything else is.
#include <dispatch/SyncToAsync.h>
#include <gmock/gmock.h>

#include "MutexProbe.h"
#include "PrivateMember.h"

namespace orvtest {

ORV_OPEN_MEMBER(DispatchersCreationMutex, ORV::SyncToAsync, s_mutexGlobal);

namespace {

TEST(StaticOrderTest, TheServiceLockComesFirstAndThenTheDispatchersMutex) {
    const pthread_mutex_t* dispatchers = nativeMutex(*memberOf(DispatchersCreationMutex{}));
    const std::vector<const pthread_mutex_t*> made = mutexesMadeFirst();
    ASSERT_EQ(made.size(), 2u) << "both have a priority, and nothing else here";
    EXPECT_NE(made[0], dispatchers);
    EXPECT_EQ(made[1], dispatchers);
}

}  // namespace
}  // namespace orvtest
