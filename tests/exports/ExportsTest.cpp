// libhsdigRemote.so exports the hsdigRemote_ functions and the four SetQLRT*
// binding functions, and nothing else: every other symbol, ours or that of a
// library linked into it, stays hidden.
#include <elf.h>
#include <fcntl.h>
#include <sys/mman.h>
#include <sys/stat.h>
#include <unistd.h>

#include <gtest/gtest.h>

#include <cstring>
#include <set>
#include <stdexcept>
#include <string>
#include <vector>

namespace {

// The names of the defined, visible symbols in the dynamic symbol table.
std::vector<std::string> exportedSymbols(const char* path) {
  int fd = ::open(path, O_RDONLY | O_CLOEXEC);
  if (fd < 0) throw std::runtime_error(std::string("cannot open ") + path);
  struct stat st {};
  ::fstat(fd, &st);
  size_t size = static_cast<size_t>(st.st_size);
  void* map = ::mmap(nullptr, size, PROT_READ, MAP_PRIVATE, fd, 0);
  ::close(fd);
  if (map == MAP_FAILED) throw std::runtime_error("cannot map the library");
  const auto* base = static_cast<const unsigned char*>(map);
  auto within = [&](size_t offset, size_t length) {
    return offset <= size && length <= size - offset;
  };

  std::vector<std::string> names;
  const auto* header = reinterpret_cast<const Elf64_Ehdr*>(base);
  if (size < sizeof(Elf64_Ehdr) || std::memcmp(header->e_ident, ELFMAG, SELFMAG) != 0 ||
      header->e_ident[EI_CLASS] != ELFCLASS64 ||
      !within(header->e_shoff, size_t(header->e_shnum) * sizeof(Elf64_Shdr))) {
    ::munmap(map, size);
    throw std::runtime_error("not a 64-bit ELF object");
  }
  const auto* sections = reinterpret_cast<const Elf64_Shdr*>(base + header->e_shoff);
  for (int i = 0; i < header->e_shnum; ++i) {
    if (sections[i].sh_type != SHT_DYNSYM || sections[i].sh_link >= header->e_shnum) continue;
    const Elf64_Shdr& symtab = sections[i];
    const Elf64_Shdr& strtab = sections[symtab.sh_link];
    if (!within(symtab.sh_offset, symtab.sh_size) || !within(strtab.sh_offset, strtab.sh_size)) {
      continue;
    }
    const auto* symbols = reinterpret_cast<const Elf64_Sym*>(base + symtab.sh_offset);
    size_t count = symtab.sh_size / sizeof(Elf64_Sym);
    const char* strings = reinterpret_cast<const char*>(base + strtab.sh_offset);
    for (size_t s = 1; s < count; ++s) {
      const Elf64_Sym& sym = symbols[s];
      if (sym.st_shndx == SHN_UNDEF) continue;
      if (ELF64_ST_VISIBILITY(sym.st_other) != STV_DEFAULT) continue;
      unsigned bind = ELF64_ST_BIND(sym.st_info);
      if (bind != STB_GLOBAL && bind != STB_WEAK && bind != STB_GNU_UNIQUE) continue;
      if (sym.st_name >= strtab.sh_size) continue;
      names.emplace_back(strings + sym.st_name,
                         strnlen(strings + sym.st_name, strtab.sh_size - sym.st_name));
    }
  }
  ::munmap(map, size);
  return names;
}

bool allowed(const std::string& name) {
  static const std::set<std::string> binding = {"SetQLRTModule", "SetQLRTTLSIndex",
                                                "SetQLRTModuleHook", "SetQLRTTLSIndexHook"};
  return name.rfind("hsdigRemote_", 0) == 0 || binding.count(name) != 0;
}

TEST(Exports, OnlyTheLibraryInterfaceIsExported) {
  std::vector<std::string> names = exportedSymbols(HSDIG_LIBRARY_PATH);
  for (const auto& name : names) {
    EXPECT_TRUE(allowed(name)) << "unexpected export: " << name;
  }
}

TEST(Exports, TheReaderSeesExportsOfAnotherLibrary) {
  // Guards the test above against passing on a reader that finds nothing:
  // Thrift's library exports its global diagnostic output.
  std::vector<std::string> names = exportedSymbols(HSDIG_THRIFT_LIBRARY);
  bool found = false;
  for (const auto& name : names) found = found || name == "_ZN6apache6thrift12GlobalOutputE";
  EXPECT_TRUE(found) << names.size() << " symbols read";
}

}  // namespace
