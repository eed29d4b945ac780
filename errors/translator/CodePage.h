// Text conversion between UTF-8 and the code page of an error-text language.
//
// Language indices: 0 English, 1 French, 2 German use code page 1252,
// 3 Japanese 932, 4 Korean 949, 5 Simplified Chinese 936. Any other index
// stands for "no particular language": its text is English and its code page
// is the system's, which on Linux is UTF-8, so such text is left unchanged.
// A character that the target cannot represent, and a byte sequence that is
// invalid in the source, becomes "?": a conversion always yields a text.
// Stateless; safe from any thread (each call opens its own converter).
#pragma once

#include <string>
#include <string_view>

namespace hsdig::translator {

// The iconv name of the language's code page, or nullptr for UTF-8.
const char* codePageOf(int language) noexcept;

// UTF-8 to the language's code page (the result of bit 30 of the flags).
std::string utf8ToCodePage(int language, std::string_view utf8);

// Text in the language's code page to UTF-8 (`mbsToUtf8`).
std::string mbsToUtf8(int language, std::string_view text);

}  // namespace hsdig::translator
