#include "tests/support/Symbols.h"

#include <algorithm>
#include <cstdint>
#include <cstdlib>
#include <cxxabi.h>
#include <dlfcn.h>
#include <link.h>
#include <memory>

namespace
{

struct SymbolTable {
    char* base = nullptr; // where the library is loaded
    ElfW(Sym) const* symbols = nullptr;
    char const* names = nullptr;
    std::uint32_t const* hashes = nullptr;

    explicit SymbolTable(void* library)
    {
        link_map* map = nullptr;
        if (dlinfo(library, RTLD_DI_LINKMAP, &map) != 0)
            return;
        base = reinterpret_cast<char*>(map->l_addr);
        for (ElfW(Dyn) const* entry = map->l_ld; entry->d_tag != DT_NULL; ++entry) {
            void const* const address = reinterpret_cast<void const*>(entry->d_un.d_ptr);
            if (entry->d_tag == DT_SYMTAB)
                symbols = static_cast<ElfW(Sym) const*>(address);
            else if (entry->d_tag == DT_STRTAB)
                names = static_cast<char const*>(address);
            else if (entry->d_tag == DT_GNU_HASH)
                hashes = static_cast<std::uint32_t const*>(address);
        }
    }

    /** @return one after the last defined symbol: the hash table lists these, the last one last */
    std::uint32_t end() const
    {
        if (!hashes)
            return 0;
        std::uint32_t const bucketCount = hashes[0];
        std::uint32_t const firstHashed = hashes[1];
        std::uint32_t const bloomWords = hashes[2] * (sizeof(ElfW(Addr)) / sizeof(std::uint32_t));
        std::uint32_t const* const buckets = hashes + 4 + bloomWords;
        std::uint32_t const* const chains = buckets + bucketCount;
        std::uint32_t last = 0;
        for (std::uint32_t bucket = 0; bucket < bucketCount; ++bucket)
            last = std::max(last, buckets[bucket]);
        if (last < firstHashed)
            return firstHashed;
        while ((chains[last - firstHashed] & 1U) == 0)
            ++last;
        return last + 1;
    }
};

/** @return the name without the tag that GCC adds if it involves the newer std::string */
std::string readable(char const* symbol)
{
    int status = 0;
    std::unique_ptr<char, void (*)(void*)> const written(
        abi::__cxa_demangle(symbol, nullptr, nullptr, &status), std::free);
    std::string name = written ? written.get() : symbol;
    std::string const mark = "[abi:cxx11]";
    if (std::string::size_type const at = name.find(mark); at != std::string::npos)
        name.erase(at, mark.size());
    return name;
}

} // namespace

void* findSymbol(void* library, std::string const& name)
{
    SymbolTable const table(library);
    std::uint32_t const end = table.end();
    for (std::uint32_t number = 1; number < end; ++number) {
        ElfW(Sym) const& symbol = table.symbols[number];
        if (symbol.st_shndx != SHN_UNDEF && readable(table.names + symbol.st_name) == name)
            return table.base + symbol.st_value;
    }
    return nullptr;
}
