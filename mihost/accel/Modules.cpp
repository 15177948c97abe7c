#include "mihost/accel/Modules.h"

#include "mihost/accel/FileStamp.h"
#include "mihost/accel/Tool.h"

#include <algorithm>
#include <cstdarg>
#include <cstdlib>
#include <cstring>
#include <dlfcn.h>
#include <libkmod.h>
#include <list>
#include <memory>
#include <string_view>

namespace miaccel
{

namespace
{

constexpr Reason complaint = "the command would write to standard error";
constexpr Reason longKey = "versions of modinfo differ in how they show a long key";

constexpr std::size_t valueColumn = 16;

template <class Owned, auto release> struct Release {
    void operator()(Owned* owned) const
    {
        release(owned);
    }
};
template <class Owned, auto release> using Owner = std::unique_ptr<Owned, Release<Owned, release>>;

using Context = Owner<kmod_ctx, kmod_unref>;
using Module = Owner<kmod_module, kmod_module_unref>;
using Modules = Owner<kmod_list, kmod_module_unref_list>;
using Facts = Owner<kmod_list, kmod_module_info_free_list>;

/** One question to libkmod. What it would write to standard error is noted instead. */
class Session
{
public:
    Session() : context_(kmod_new(runningKernel, noConfiguration))
    {
        if (context_)
            kmod_set_log_fn(context_.get(), &Session::note, this);
    }
    Session(Session const&) = delete;
    Session& operator=(Session const&) = delete;

    kmod_ctx* context() const
    {
        return context_.get();
    }

    void stepAside(Reason reason)
    {
        reason_ = reason;
    }

    Answer answer(std::string text) const
    {
        return reason_ ? Answer::none(reason_) : Answer::with(std::move(text));
    }

private:
    static void note(void* self, int, char const*, int, char const*, char const*, va_list)
    {
        static_cast<Session*>(self)->stepAside(complaint);
    }

    static constexpr char const* runningKernel = nullptr;
    static constexpr char const* noConfiguration[] = {nullptr};

    Context context_;
    Reason reason_ = nullptr;
};

template <class Do> void forEach(kmod_list const* list, Do each)
{
    for (kmod_list const* entry = list; entry; entry = kmod_list_next(list, entry))
        each(entry);
}

std::string padded(std::string text, std::size_t width)
{
    text.resize(std::max(text.size(), width), ' ');
    return text;
}

std::string rightAligned(std::string const& text, std::size_t width)
{
    return std::string(width - std::min(width, text.size()), ' ') + text;
}

std::string holdersOf(kmod_module const* module)
{
    Modules const holders(kmod_module_get_holders(module));
    std::string names;
    forEach(holders.get(), [&](kmod_list const* entry) {
        Module const holder(kmod_module_get_module(entry));
        names += names.empty() ? ' ' : ',';
        names += kmod_module_get_name(holder.get());
    });
    return names;
}

std::string loadedLine(kmod_module const* module)
{
    return padded(kmod_module_get_name(module), 19) + ' ' +
           rightAligned(std::to_string(kmod_module_get_size(module)), 8) + "  " +
           std::to_string(kmod_module_get_refcnt(module)) + holdersOf(module) + '\n';
}

std::string factLine(std::string_view key, std::string_view value)
{
    std::string line(key);
    line += ':';
    return padded(line, valueColumn).append(value) + '\n';
}

/** A module's parameters; modules give the text and the type of one apart, in any order. */
class Parameters
{
public:
    /** @return false where the value has no colon */
    bool add(std::string_view value, bool isType)
    {
        std::string_view::size_type const colon = value.find(':');
        if (colon == std::string_view::npos)
            return false;
        Parameter& parameter = named(value.substr(0, colon));
        (isType ? parameter.type : parameter.text) = value.substr(colon + 1);
        return true;
    }

    /** The parameter first seen last comes first. */
    std::string lines() const
    {
        std::string text;
        for (Parameter const& parameter : parameters_)
            text += factLine("parm", std::string(parameter.name) + ':' + described(parameter));
        return text;
    }

private:
    struct Parameter {
        std::string_view name;
        std::string_view text; // its data is null where there is none
        std::string_view type; // likewise
    };

    static std::string described(Parameter const& parameter)
    {
        if (!parameter.text.data())
            return std::string(parameter.type);
        std::string text(parameter.text);
        if (parameter.type.data())
            text.append(" (").append(parameter.type).append(")");
        return text;
    }

    Parameter& named(std::string_view name)
    {
        auto const known =
            std::find_if(parameters_.begin(), parameters_.end(),
                         [name](Parameter const& parameter) { return parameter.name == name; });
        if (known != parameters_.end())
            return *known;
        parameters_.push_front({name, {}, {}});
        return parameters_.front();
    }

    std::list<Parameter> parameters_;
};

std::string factsOf(kmod_module const* module, Session& session)
{
    char const* const path = kmod_module_get_path(module);
    std::string text;
    if (!path)
        text += factLine("name", kmod_module_get_name(module));
    text += factLine("filename", path ? path : "(builtin)");
    kmod_list* list = nullptr;
    int const got = kmod_module_get_info(module, &list);
    Facts const facts(list);
    // Old kernels say nothing of what they have built in, and the command takes that as it is.
    if (got < 0 && (path || got != -ENOENT))
        session.stepAside(complaint);
    if (got < 0)
        return text;
    Parameters parameters;
    forEach(facts.get(), [&](kmod_list const* entry) {
        std::string_view const key = kmod_module_info_get_key(entry);
        char const* const value = kmod_module_info_get_value(entry);
        if (key.size() >= valueColumn)
            session.stepAside(longKey);
        if (key != "parm" && key != "parmtype")
            text += factLine(key, value);
        else if (!parameters.add(value, key == "parmtype"))
            session.stepAside(complaint);
    });
    return text + parameters.lines();
}

} // namespace

Reason strangeLibrary()
{
    Dl_info own{};
    if (dladdr(reinterpret_cast<void*>(&kmod_new), &own) == 0)
        return "libkmod cannot be found";
    std::unique_ptr<char, decltype(&std::free)> const path(realpath(own.dli_fname, nullptr),
                                                           &std::free);
    std::optional<FileStamp> const stamp = FileStamp::of(path ? path.get() : "");
    if (!stamp || !stamp->isOlderThanProcess() || !isGenuine({path.get(), "libkmod2", "30+ 34.2-"}))
        return "libkmod is not the one of the commands";
    return nullptr;
}

Answer lsmod()
{
    Session session;
    kmod_list* list = nullptr;
    if (!session.context() || kmod_module_new_from_loaded(session.context(), &list) < 0)
        return Answer::none(complaint);
    Modules const modules(list);
    std::string text = "Module                  Size  Used by\n";
    forEach(modules.get(), [&text](kmod_list const* entry) {
        Module const module(kmod_module_get_module(entry));
        text += loadedLine(module.get());
    });
    return session.answer(std::move(text));
}

Answer modinfo(std::string const& name)
{
    Session session;
    kmod_list* list = nullptr;
    if (!session.context() ||
        kmod_module_new_from_lookup(session.context(), name.c_str(), &list) < 0 || !list)
        return Answer::none(complaint);
    Modules const modules(list);
    std::string text;
    forEach(modules.get(), [&](kmod_list const* entry) {
        Module const module(kmod_module_get_module(entry));
        text += factsOf(module.get(), session);
    });
    return session.answer(std::move(text));
}

} // namespace miaccel
