#include "mihost/accel/Answers.h"

#include <algorithm>
#include <array>
#include <cstdarg>
#include <cstdio>
#include <libkmod.h>
#include <memory>
#include <string_view>
#include <vector>

namespace miaccel
{

namespace
{

constexpr Reason complaint = "the command would write to standard error";
constexpr std::size_t valueColumn = 16;

template <auto release> struct Release {
    template <class Owned> void operator()(Owned* owned) const
    {
        release(owned);
    }
};
using Module = std::unique_ptr<kmod_module, Release<kmod_module_unref>>;
using Modules = std::unique_ptr<kmod_list, Release<kmod_module_unref_list>>;
using Facts = std::unique_ptr<kmod_list, Release<kmod_module_info_free_list>>;

/** libkmod for one query. What it would write to standard error is recorded instead. */
class Library
{
public:
    Library() : context_(kmod_new(runningKernel, noConfiguration))
    {
        if (context_)
            kmod_set_log_fn(context_.get(), &Library::note, &complained_);
    }

    kmod_ctx* context() const
    {
        return context_.get();
    }
    bool complained() const
    {
        return complained_;
    }

private:
    static void note(void* complained, int, char const*, int, char const*, char const*, va_list)
    {
        *static_cast<bool*>(complained) = true;
    }

    static constexpr char const* runningKernel = nullptr;
    static constexpr char const* noConfiguration[] = {nullptr};

    std::unique_ptr<kmod_ctx, Release<kmod_unref>> context_;
    bool complained_ = false;
};

template <class Do> void forEachModule(kmod_list const* list, Do each)
{
    for (kmod_list const* entry = list; entry; entry = kmod_list_next(list, entry))
        each(Module(kmod_module_get_module(entry)).get());
}

std::string holdersOf(kmod_module const* module)
{
    std::string names;
    forEachModule(Modules(kmod_module_get_holders(module)).get(), [&](kmod_module const* holder) {
        names += names.empty() ? ' ' : ',';
        names += kmod_module_get_name(holder);
    });
    return names;
}

std::string loadedLine(kmod_module const* module)
{
    std::array<char, 256> line{};
    std::snprintf(line.data(), line.size(), "%-19s %8ld  %d", kmod_module_get_name(module),
                  kmod_module_get_size(module), kmod_module_get_refcnt(module));
    return line.data() + holdersOf(module) + '\n';
}

std::string factLine(std::string_view key, std::string const& value)
{
    std::string line(key);
    line += ':';
    line.resize(std::max(line.size(), valueColumn), ' ');
    return line + value + '\n';
}

/** In a module the text and the type of a parameter are separate entries, in any order. */
struct Parameter {
    std::string name;
    std::optional<std::string> text = {};
    std::optional<std::string> type = {};

    std::string line() const
    {
        if (!text)
            return factLine("parm", name + ':' + *type);
        return factLine("parm", name + ':' + *text + (type ? " (" + *type + ')' : ""));
    }
};

/** @return false if the value is not that of a parameter */
bool add(std::vector<Parameter>& parameters, std::string const& value, bool isType)
{
    std::string::size_type const colon = value.find(':');
    if (colon == std::string::npos)
        return false;
    std::string const name = value.substr(0, colon);
    auto found = std::find_if(parameters.begin(), parameters.end(),
                              [&name](Parameter const& one) { return one.name == name; });
    if (found == parameters.end())
        found = parameters.insert(found, {name});
    (isType ? found->type : found->text) = value.substr(colon + 1);
    return true;
}

Answer factsOf(kmod_module const* module)
{
    char const* const path = kmod_module_get_path(module);
    if (!path)
        return declined("some versions of modinfo do not know built-in modules");
    kmod_list* list = nullptr;
    int const got = kmod_module_get_info(module, &list);
    Facts const facts(list);
    if (got < 0)
        return declined(complaint);
    std::string text = factLine("filename", path);
    std::vector<Parameter> parameters;
    for (kmod_list const* fact = list; fact; fact = kmod_list_next(list, fact)) {
        std::string_view const key = kmod_module_info_get_key(fact);
        std::string const value = kmod_module_info_get_value(fact);
        if (key.size() >= valueColumn)
            return declined("versions of modinfo print a long key differently");
        if (key != "parm" && key != "parmtype")
            text += factLine(key, value);
        else if (!add(parameters, value, key == "parmtype"))
            return declined(complaint);
    }
    // The parameter that was first seen last comes first.
    std::for_each(parameters.rbegin(), parameters.rend(),
                  [&text](Parameter const& parameter) { text += parameter.line(); });
    return {std::move(text)};
}

} // namespace

Answer lsmod(Operands const&)
{
    Library const library;
    kmod_list* list = nullptr;
    if (!library.context() || kmod_module_new_from_loaded(library.context(), &list) < 0)
        return declined(complaint);
    Modules const modules(list);
    std::string text = "Module                  Size  Used by\n";
    forEachModule(list, [&text](kmod_module const* module) { text += loadedLine(module); });
    return library.complained() ? declined(complaint) : Answer{std::move(text)};
}

Answer modinfo(Operands const& operands)
{
    Library const library;
    kmod_list* list = nullptr;
    if (!library.context() ||
        kmod_module_new_from_lookup(library.context(), operands.name.c_str(), &list) < 0 || !list)
        return declined(complaint);
    Modules const modules(list);
    if (kmod_list_next(list, list))
        return declined("the name is an alias of several modules");
    Answer facts = factsOf(Module(kmod_module_get_module(list)).get());
    return library.complained() ? declined(complaint) : facts;
}

} // namespace miaccel
