// SPDX-License-Identifier: Apache-2.0
#pragma once

namespace orvtest {

// Opens one private member of a class to a test: the names in an explicit
// instantiation are not subject to access checks. At namespace scope:
//
//     struct Listener { friend auto memberOf(Listener); };
//     template struct PrivateMember<Listener, &Player::mListener>;
//
// then object.*memberOf(Listener{}) is the member, or calls it if it is a function.
template <class Tag, auto Member>
struct PrivateMember {
    friend auto memberOf(Tag) { return Member; }
};

}  // namespace orvtest
