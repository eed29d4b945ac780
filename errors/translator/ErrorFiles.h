// Status explanation files: the error texts kept outside the term tables.
//
// A folder holds any number of files whose extension is "txt" or "err"
// (compared without regard to case). Each file is line based (lines of up
// to 1024 characters; tags compared without regard to case):
//   <?xml version="1.0" ...?>        only its first 19 characters are compared
//   <cvdocument>
//   <cvcomment> ... </cvcomment>     skipped
//   <cverror code="0xBFFA1190">      code read as "%i" reads an integer
//   description lines
//   </cverror>
//   </cvdocument>
// Blank lines between sections are ignored; any other line is a bad section
// heading. Files are searched in name order; the first one that defines the
// code wins. Stateless; safe from any thread.
#pragma once

#include <cstdint>
#include <optional>
#include <string>

namespace hsdig::translator {

inline constexpr const char* kCouldNotOpenFile = "Could not open status explanations file";
inline constexpr const char* kCouldNotRead = "Could not successfully read the status data!";
inline constexpr const char* kBadSectionHeading =
    "Bad explanation file. Unidentified section heading !";
inline constexpr const char* kMissingEnd =
    "Bad explanation file. Could not find the end of the status code definition !";
inline constexpr const char* kOpenDirFailed = "open dir failed";
inline constexpr const char* kFileInfoFailed = "get file info failed";

struct ErrorFileLookup {
  std::optional<std::string> text;  // the description, when found
  std::string failure;              // the first failure met on the way, if any
};

// Looks `code` up in one file.
ErrorFileLookup searchErrorFile(const std::string& path, int32_t code);

// Looks `code` up in every explanation file of `folder`. A folder that does
// not exist is not a failure: it simply defines nothing.
ErrorFileLookup searchErrorFolder(const std::string& folder, int32_t code);

}  // namespace hsdig::translator
