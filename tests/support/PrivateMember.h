// SPDX-License-Identifier: Apache-2.0
#pragma once

namespace orvtest {

template <class Tag, auto Member>
struct PrivateMember {
    friend auto memberOf(Tag) { return Member; }
};

}  // namespace orvtest

// Opens one private member of a class to a test: the names in an explicit
// instantiation are not subject to access checks. In namespace orvtest:
//
//     ORV_OPEN_MEMBER(Listener, Player, mListener);
//
// then object.*memberOf(Listener{}) is the member, or calls it if it is a function.
#define ORV_OPEN_MEMBER(Tag, Class, member) \
    struct Tag {                            \
        friend auto memberOf(Tag);          \
    };                                      \
    template struct PrivateMember<Tag, &Class::member>
