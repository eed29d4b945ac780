#include "errors/translator/CodePage.h"

#include <iconv.h>

#include <cerrno>
#include <cstddef>

namespace hsdig::translator {

namespace {

// Owner of one iconv descriptor.
class Converter {
 public:
  Converter(const char* to, const char* from) : cd_(iconv_open(to, from)) {}
  ~Converter() {
    if (ok()) iconv_close(cd_);
  }
  Converter(const Converter&) = delete;
  Converter& operator=(const Converter&) = delete;
  bool ok() const { return cd_ != reinterpret_cast<iconv_t>(-1); }
  iconv_t get() const { return cd_; }

 private:
  iconv_t cd_;
};

// Length of the UTF-8 sequence that starts with `lead`, 1 for a byte that
// cannot start one (it is then skipped on its own).
std::size_t utf8Length(unsigned char lead) {
  if (lead >= 0xF0 && lead <= 0xF4) return 4;
  if (lead >= 0xE0) return lead <= 0xEF ? 3 : 1;
  if (lead >= 0xC2) return 2;
  return 1;
}

// Converts `text`; an unconvertible or invalid input unit becomes "?" and the
// conversion goes on after it. `utf8Input` decides how long that unit is.
std::string convert(const char* to, const char* from, std::string_view text, bool utf8Input) {
  Converter converter(to, from);
  if (!converter.ok()) return std::string(text);
  std::string out;
  out.reserve(text.size() + text.size() / 2 + 8);
  char* in = const_cast<char*>(text.data());
  std::size_t inLeft = text.size();
  char chunk[1024];
  while (inLeft > 0) {
    char* outPtr = chunk;
    std::size_t outLeft = sizeof chunk;
    std::size_t rc = iconv(converter.get(), &in, &inLeft, &outPtr, &outLeft);
    out.append(chunk, static_cast<std::size_t>(outPtr - chunk));
    if (rc != static_cast<std::size_t>(-1)) continue;
    if (errno == E2BIG) continue;
    // EILSEQ or EINVAL: replace the offending unit and resynchronise.
    std::size_t skip = utf8Input ? utf8Length(static_cast<unsigned char>(*in)) : 1;
    if (skip > inLeft) skip = inLeft;
    if (utf8Input && skip > 1) {
      for (std::size_t i = 1; i < skip; ++i) {
        if ((static_cast<unsigned char>(in[i]) & 0xC0) != 0x80) {
          skip = i;
          break;
        }
      }
    }
    in += skip;
    inLeft -= skip;
    out.push_back('?');
    iconv(converter.get(), nullptr, nullptr, nullptr, nullptr);
  }
  return out;
}

bool isAscii(std::string_view text) {
  for (unsigned char c : text) {
    if (c >= 0x80) return false;
  }
  return true;
}

}  // namespace

const char* codePageOf(int language) noexcept {
  switch (language) {
    case 0:
    case 1:
    case 2:
      return "CP1252";
    case 3:
      return "CP932";
    case 4:
      return "CP949";
    case 5:
      return "CP936";
    default:
      return nullptr;
  }
}

std::string utf8ToCodePage(int language, std::string_view utf8) {
  const char* page = codePageOf(language);
  if (page == nullptr || isAscii(utf8)) return std::string(utf8);
  return convert(page, "UTF-8", utf8, true);
}

std::string mbsToUtf8(int language, std::string_view text) {
  const char* page = codePageOf(language);
  if (page == nullptr || isAscii(text)) return std::string(text);
  return convert("UTF-8", page, text, false);
}

}  // namespace hsdig::translator
