// libhsdig.so exports exactly the driver functions of the table plus the two
// host functions, read from its dynamic symbol table.
#include <dlfcn.h>
#include <elf.h>
#include <fcntl.h>
#include <sys/mman.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cstring>
#include <set>
#include <stdexcept>

#include "DigitizerTestSupport.h"

namespace {

// The defined, default-visibility global symbols of an ELF64 shared object's
// .dynsym, with every offset checked against the file size.
std::set<std::string> dynamicSymbols(const char* path) {
  int fd = ::open(path, O_RDONLY | O_CLOEXEC);
  if (fd < 0) throw std::runtime_error(std::string("cannot open ") + path);
  struct stat st {};
  if (::fstat(fd, &st) != 0) {
    ::close(fd);
    throw std::runtime_error("cannot stat the library");
  }
  const size_t size = static_cast<size_t>(st.st_size);
  void* map = ::mmap(nullptr, size, PROT_READ, MAP_PRIVATE, fd, 0);
  ::close(fd);
  if (map == MAP_FAILED) throw std::runtime_error("cannot map the library");
  const auto* base = static_cast<const unsigned char*>(map);
  auto fits = [&](size_t offset, size_t length) {
    return offset <= size && length <= size - offset;
  };
  std::set<std::string> names;
  const auto* eh = reinterpret_cast<const Elf64_Ehdr*>(base);
  if (fits(0, sizeof(Elf64_Ehdr)) && std::memcmp(eh->e_ident, ELFMAG, SELFMAG) == 0 &&
      eh->e_ident[EI_CLASS] == ELFCLASS64 &&
      fits(eh->e_shoff, size_t(eh->e_shnum) * sizeof(Elf64_Shdr))) {
    const auto* sh = reinterpret_cast<const Elf64_Shdr*>(base + eh->e_shoff);
    for (int i = 0; i < eh->e_shnum; ++i) {
      if (sh[i].sh_type != SHT_DYNSYM || sh[i].sh_link >= eh->e_shnum) continue;
      const Elf64_Shdr& strtab = sh[sh[i].sh_link];
      if (!fits(sh[i].sh_offset, sh[i].sh_size) || !fits(strtab.sh_offset, strtab.sh_size))
        continue;
      const auto* syms = reinterpret_cast<const Elf64_Sym*>(base + sh[i].sh_offset);
      const char* strings = reinterpret_cast<const char*>(base + strtab.sh_offset);
      for (size_t s = 1; s < sh[i].sh_size / sizeof(Elf64_Sym); ++s) {
        const Elf64_Sym& sym = syms[s];
        if (sym.st_shndx == SHN_UNDEF || ELF64_ST_VISIBILITY(sym.st_other) != STV_DEFAULT) continue;
        if (ELF64_ST_BIND(sym.st_info) == STB_LOCAL || sym.st_name >= strtab.sh_size) continue;
        names.emplace(strings + sym.st_name,
                      strnlen(strings + sym.st_name, strtab.sh_size - sym.st_name));
      }
    }
  }
  ::munmap(map, size);
  return names;
}

std::string libraryPath() {
  Dl_info info{};
  if (!dladdr(reinterpret_cast<void*>(&hsdig_close), &info) || !info.dli_fname) return {};
  return info.dli_fname;
}

TEST(DigitizerExports, ExactlyTheTableAndTheHostFunctions) {
  std::set<std::string> expected;
#define HSDIG_NAME(name, params, args) expected.insert("hsdig_" #name);
  HSDIG_DRIVER_FUNCTIONS(HSDIG_NAME)
  ASSERT_EQ(expected.size(), size_t{HSDIG_DRIVER_FUNCTION_COUNT});
  HSDIG_HOST_FUNCTIONS(HSDIG_NAME)
#undef HSDIG_NAME
  const std::string path = libraryPath();
  ASSERT_NE(path.find("libhsdig.so"), std::string::npos) << path;
  std::set<std::string> exported;
  for (const std::string& name : dynamicSymbols(path.c_str())) {
    if (name.rfind("_init", 0) == 0 || name.rfind("_fini", 0) == 0) continue;
    exported.insert(name);
  }
  EXPECT_EQ(exported, expected);
}

// A handle that is no session is refused with its own error, recorded on
// the calling thread's session 0, and outputs stay untouched.
TEST(DigitizerExports, AnUnknownSessionIsRefusedBeforeAnythingElse) {
  constexpr ViSession kNoSession = 0x7FFFFFF0;
  hsdig::test::takeError(0);
  ViReal64 value = 0;
  hsdigWfmInfo info{};
  struct Case {
    const char* name;
    ViStatus status;
  };
  const Case cases[] = {
      {"hsdig_Abort", hsdig_Abort(kNoSession)},
      {"hsdig_ConfigureVertical", hsdig_ConfigureVertical(kNoSession, "0", 1, 0, 1, 1, 1)},
      {"hsdig_GetAttributeViReal64",
       hsdig_GetAttributeViReal64(kNoSession, "0", HSDIG_ATTR_VERTICAL_RANGE, &value)},
      {"hsdig_Fetch", hsdig_Fetch(kNoSession, "0", 0, 1, &value, &info)},
      {"hsdig_close", hsdig_close(kNoSession)},
  };
  for (const Case& c : cases) {
    SCOPED_TRACE(c.name);
    EXPECT_EQ(c.status, HSDIG_ERROR_INVALID_SESSION);
  }
  // Error information keeps the first error of the thread's session 0.
  hsdig::test::ErrorInfo e = hsdig::test::takeError(0);
  EXPECT_EQ(e.primary, HSDIG_ERROR_INVALID_SESSION);
  EXPECT_NE(e.elaboration.find("hsdig_Abort"), std::string::npos) << e.elaboration;
  EXPECT_EQ(value, 0.0);
  EXPECT_EQ(info.actualSamples, 0);
}

}  // namespace
