// Reads the dynamic symbol table of a shared object, so tests can check what
// a library exports without an outside tool.
#pragma once

#include <elf.h>
#include <fcntl.h>
#include <sys/mman.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cstring>
#include <stdexcept>
#include <string>
#include <vector>

namespace hsdig::test {

// The names of the defined, visible symbols in the dynamic symbol table.
inline std::vector<std::string> exportedSymbols(const char* path) {
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

}  // namespace hsdig::test
