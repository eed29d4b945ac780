#include "session/AnsiText.h"

#include <iconv.h>
#include <langinfo.h>

#include <algorithm>
#include <cerrno>
#include <new>

#include "errors/ErrorDescription.h"
#include "errors/Exception.h"

namespace hsdig {
namespace {

constexpr ViStatus kOutOfMemory = -52000;

[[noreturn]] void fail(std::string_view api, int error, std::string_view what) {
  Status status(kTextConversionFailed);
  description::addInternalError(status, api, error, what);
  throw Exception(status);
}

class Converter {
 public:
  explicit Converter(const std::string& from) : cd_(iconv_open("UTF-8", from.c_str())) {
    if (cd_ == reinterpret_cast<iconv_t>(-1)) fail("iconv_open", errno, from);
  }
  ~Converter() { iconv_close(cd_); }
  Converter(const Converter&) = delete;
  Converter& operator=(const Converter&) = delete;
  iconv_t get() const { return cd_; }

 private:
  iconv_t cd_;
};

}  // namespace

std::string ansiCodeSet() {
  const char* codeSet = nl_langinfo(CODESET);
  const std::string name = codeSet ? codeSet : "";
  if (name.empty() || name == "ANSI_X3.4-1968" || name == "ASCII") return "UTF-8";
  return name;
}

std::string ansiToUtf8(std::string_view text) {
  if (std::all_of(text.begin(), text.end(),
                  [](char c) { return static_cast<unsigned char>(c) < 128; })) {
    return std::string(text);
  }
  return ansiToUtf8(text, ansiCodeSet());
}

std::string ansiToUtf8(std::string_view text, const std::string& codeSet) {
  if (std::all_of(text.begin(), text.end(),
                  [](char c) { return static_cast<unsigned char>(c) < 128; })) {
    return std::string(text);
  }
  try {
    Converter converter(codeSet);
    std::string in(text);
    // Every input byte becomes at most four UTF-8 bytes.
    std::string out(in.size() * 4 + 4, '\0');
    char* inPtr = in.data();
    size_t inLeft = in.size();
    char* outPtr = out.data();
    size_t outLeft = out.size();
    if (iconv(converter.get(), &inPtr, &inLeft, &outPtr, &outLeft) == static_cast<size_t>(-1)) {
      fail("iconv", errno, "invalid or incomplete character for " + codeSet);
    }
    out.resize(out.size() - outLeft);
    return out;
  } catch (const std::bad_alloc&) {
    throw Exception(kOutOfMemory);
  }
}

}  // namespace hsdig
