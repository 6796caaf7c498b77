// TCVN3 (VN3) text, one byte per character. The engine keeps every text in
// these bytes; Unicode appears only at the edges (window, command line).
#pragma once

#include <string>
#include <string_view>

namespace kavu {

// UTF-8 to TCVN3. A capital with a tone mark is written with the lowercase
// letter's code (the capitals font shows it as a capital); a character
// without a code becomes "?". Private-use characters U+F780..U+F7FF, which
// Tcvn3ToUtf8 makes of bytes outside TCVN3, turn back into those bytes.
std::string Utf8ToTcvn3(std::string_view utf8);

// TCVN3 to UTF-8 for display. Bytes below 0x80 are ASCII; a byte at 0x80 or
// above that is not a TCVN3 letter becomes U+F700 + byte, so an edited text
// saved back keeps every byte.
std::string Tcvn3ToUtf8(std::string_view tcvn3);

}  // namespace kavu
