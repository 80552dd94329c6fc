// SPDX-License-Identifier: Apache-2.0
#pragma once

#include <orvtarn/RecordText.h>
#include <stddef.h>

#include <string_view>

// Fills the fixed text arrays of the engine's records from UTF-8. Input that is
// not valid UTF-8 is taken with U+FFFD in place of each ill-formed part (as
// browsers do), never refused; what does not fit is cut at a whole character.
// Pure functions, safe on any thread.
namespace orvtarn {

// Modified UTF-8, always terminated, so at most 127 bytes: U+0000 takes two
// bytes, characters beyond U+FFFF six (a surrogate pair of three bytes each).
// The bytes behind the text are zero. Answers how many bytes of the input it
// took.
size_t setText(OrvText& text, std::string_view utf8);

// UTF-16. A text of 128 units or more fills the array without a terminator;
// the units behind a shorter one are zero. A U+0000 becomes U+FFFD, since a
// zero unit would end the text.
void setWideText(OrvWideText& text, std::string_view utf8);

}  // namespace orvtarn
