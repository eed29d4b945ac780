// The shared folder of error files, and the expansion of "$name" variables
// in translator settings.
//
// There is no registry on Linux: the shared folder is install-relative. It is
// "share/Corvana/Shared" under the installation prefix, the parent of the
// folder that holds the binary this code is linked into (for
// <prefix>/lib/libhsdigRemote.so that is <prefix>/share/Corvana/Shared; in the
// build tree build/share/Corvana/Shared). Both "_cvShared32Dir" and
// "_cvSharedDir" name it. Immutable after first use; safe from any thread.
#pragma once

#include <string>
#include <string_view>

namespace hsdig::translator {

// The install-relative shared folder (computed once).
const std::string& installSharedFolder();

// Replaces "$_cvShared32Dir" and "$_cvSharedDir" in `path` by `sharedFolder`.
// Other text, and "$" not followed by one of these names, stays as it is.
std::string expandPath(std::string_view path, const std::string& sharedFolder);

}  // namespace hsdig::translator
