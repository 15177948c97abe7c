#include "mihost/cli/check/Symbols.h"

#include "mihost/runtime/Runtime.h"

#include <algorithm>
#include <cstdint>
#include <cstdlib>
#include <cxxabi.h>
#include <dlfcn.h>
#include <fmt/format.h>
#include <link.h>
#include <memory>
#include <set>
#include <stdexcept>
#include <string_view>

namespace mihost::checks
{

namespace
{

/** A library that is already loaded, kept loaded while it is examined. */
class LoadedLibrary
{
public:
    explicit LoadedLibrary(std::string const& file)
        : handle_(dlopen(file.c_str(), RTLD_NOW | RTLD_NOLOAD))
    {
        if (!handle_ || dlinfo(handle_, RTLD_DI_LINKMAP, &map_) != 0)
            throw std::runtime_error("the library is not loaded");
    }
    ~LoadedLibrary()
    {
        dlclose(handle_);
    }
    LoadedLibrary(LoadedLibrary const&) = delete;
    LoadedLibrary& operator=(LoadedLibrary const&) = delete;

    /** An entry of its dynamic section, as the loader relocated it; null if there is none. */
    template <class Content> Content const* table(decltype(ElfW(Dyn)::d_tag) tag) const
    {
        for (ElfW(Dyn) const* entry = map_->l_ld; entry->d_tag != DT_NULL; ++entry)
            if (entry->d_tag == tag)
                // NOLINTNEXTLINE(performance-no-int-to-ptr): the loader keeps addresses as numbers
                return reinterpret_cast<Content const*>(entry->d_un.d_ptr);
        return nullptr;
    }

    /** @return what one of its undefined names refers to: in its libraries, else in the host */
    void const* find(std::string const& symbol) const
    {
        // A host or a sanitizer may interpose a library's function.
        void const* const brought = dlsym(handle_, symbol.c_str());
        return brought ? brought : dlsym(RTLD_DEFAULT, symbol.c_str());
    }

    /** The names of the libraries that it needs. */
    std::set<std::string> needed() const
    {
        std::set<std::string> names;
        auto const* const strings = table<char>(DT_STRTAB);
        for (ElfW(Dyn) const* entry = map_->l_ld; entry->d_tag != DT_NULL; ++entry)
            if (strings && entry->d_tag == DT_NEEDED)
                names.insert(strings + entry->d_un.d_val);
        return names;
    }

private:
    void* handle_;
    link_map* map_ = nullptr;
};

struct GnuHashTable {
    std::uint32_t buckets;
    std::uint32_t firstHashed;
    std::uint32_t filterWords;
    std::uint32_t shift;
};

/** The number of symbols; the table itself does not hold it. */
std::size_t symbolCount(LoadedLibrary const& library)
{
    if (auto const* const hash = library.table<std::uint32_t>(DT_HASH))
        return hash[1]; // as many chains as symbols
    auto const* const header = library.table<GnuHashTable>(DT_GNU_HASH);
    if (!header)
        throw std::runtime_error("the library has no symbol hash table");
    auto const* const filter = reinterpret_cast<ElfW(Addr) const*>(header + 1);
    auto const* const buckets =
        reinterpret_cast<std::uint32_t const*>(filter + header->filterWords);
    auto const* const chains = buckets + header->buckets;
    std::uint32_t const last = *std::max_element(buckets, buckets + header->buckets);
    if (last < header->firstHashed)
        return header->firstHashed;
    std::uint32_t at = last;
    while ((chains[at - header->firstHashed] & 1) == 0)
        ++at;
    return at + 1;
}

std::string demangled(std::string const& symbol)
{
    int status = 0;
    std::unique_ptr<char, decltype(&std::free)> const text(
        abi::__cxa_demangle(symbol.c_str(), nullptr, nullptr, &status), std::free);
    return text ? text.get() : symbol;
}

std::string fileOf(void const* address)
{
    Dl_info info{};
    return address && dladdr(address, &info) != 0 && info.dli_fname ? info.dli_fname : "";
}

std::string lastPart(std::string const& path)
{
    return path.substr(path.rfind('/') + 1);
}

/** Up to the parameters, without the marks of the ABI: "IC::OsSwMI::OsSwMI". */
std::string withoutParameters(std::string name)
{
    for (std::string const mark : {"[abi:cxx11]"})
        if (std::size_t const at = name.find(mark); at != std::string::npos)
            name.erase(at, mark.size());
    return name.substr(0, name.find('('));
}

} // namespace

std::vector<Symbol> symbolsOf(std::string const& file)
{
    constexpr std::uint16_t firstNamedVersion = 2; // 0 is local, 1 without a version
    constexpr std::uint16_t versionBits = 0x7fff;
    LoadedLibrary const library(file);
    auto const* const table = library.table<ElfW(Sym)>(DT_SYMTAB);
    auto const* const strings = library.table<char>(DT_STRTAB);
    auto const* const versions = library.table<std::uint16_t>(DT_VERSYM);
    std::vector<Symbol> symbols;
    std::size_t const count = symbolCount(library);
    for (std::size_t at = 1; at < count; ++at) // the first one is a blank
        symbols.push_back({strings + table[at].st_name, table[at].st_shndx != SHN_UNDEF,
                           ELF64_ST_BIND(table[at].st_info) == STB_WEAK,
                           versions && (versions[at] & versionBits) >= firstNamedVersion});
    return symbols;
}

bool isHostName(std::string const& symbol)
{
    std::string_view rest = symbol;
    auto const skip = [&rest](std::string_view start) {
        bool const begins = rest.substr(0, start.size()) == start;
        if (begins)
            rest.remove_prefix(start.size());
        return begins;
    };
    if (!skip("_Z"))
        return false;
    for (std::string_view const special : {"TI", "TS", "TV"})
        if (skip(special))
            break;
    if (!skip("N"))
        return false;
    skip("K");
    return skip("2IC") || skip("2NQ") || skip("5VXLog");
}

Findings wantedBeyondTheContract(std::vector<Symbol> const& symbols, std::string const& file)
{
    constexpr std::string_view ofTheCompiler = "__";
    LoadedLibrary const library(file);
    std::set<std::string> const needed = library.needed();
    std::string const runtime = fileOf(reinterpret_cast<void const*>(&setLogSink));
    Findings findings;
    for (Symbol const& symbol : symbols) {
        if (symbol.defined || symbol.weak || symbol.versioned ||
            symbol.name.compare(0, ofTheCompiler.size(), ofTheCompiler) == 0)
            continue;
        std::string const provider = fileOf(library.find(symbol.name));
        bool const declared = provider == runtime && isHostName(symbol.name);
        if (!declared && needed.count(lastPart(provider)) == 0)
            findings.push_back(fmt::format("{}: no header of host/ declares it, although {} has it",
                                           demangled(symbol.name), lastPart(provider)));
    }
    return findings;
}

std::vector<std::string> missingPublicNames(std::vector<Symbol> const& symbols)
{
    std::set<std::string> defined;
    for (Symbol const& symbol : symbols)
        if (symbol.defined)
            defined.insert(withoutParameters(demangled(symbol.name)));
    std::vector<std::string> missing;
    for (char const* name : publicNames())
        if (defined.count(name) == 0)
            missing.emplace_back(name);
    return missing;
}

} // namespace mihost::checks
