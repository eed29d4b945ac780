// Conversion of text in the process's ANSI code page to UTF-8, through
// iconv.
//
// On Linux the ANSI code page is the character set of the C library's
// current LC_CTYPE locale. The plain C/POSIX locale ("ANSI_X3.4-1968") counts
// as UTF-8, the character set of every modern Linux system, so that a
// program that never calls setlocale still has its UTF-8 names accepted.
// Text whose bytes are all below 128 is copied unchanged; anything else is
// converted, and an invalid or incomplete character fails: Exception with
// kTextConversionFailed (-52027); out of memory -52000.
#pragma once

#include <string>
#include <string_view>

#include "hsdigRemote/vitypes.h"

namespace hsdig {

inline constexpr ViStatus kTextConversionFailed = -52027;

// The character set name (for iconv) that stands for the ANSI code page.
std::string ansiCodeSet();

std::string ansiToUtf8(std::string_view text);
// The same from an explicit character set (for example "CP1252", "CP932",
// "GB18030").
std::string ansiToUtf8(std::string_view text, const std::string& codeSet);

}  // namespace hsdig
