#include "mihost/accel/Date.h"

#include "mihost/accel/FileStamp.h"

#include <array>
#include <cstdlib>
#include <cstring>
#include <langinfo.h>
#include <locale.h>
#include <memory>
#include <optional>
#include <type_traits>

namespace miaccel
{

namespace
{

struct FreeLocale {
    void operator()(locale_t locale) const
    {
        freelocale(locale);
    }
};
using Locale = std::unique_ptr<std::remove_pointer_t<locale_t>, FreeLocale>;

/** Whether it comes with the C library itself, so that no file has a part in it. */
bool isBuiltIn(locale_t locale)
{
    for (int category = LC_CTYPE; category <= LC_IDENTIFICATION; ++category)
        if (category != LC_ALL &&
            std::strcmp(nl_langinfo_l(_NL_LOCALE_NAME(category), locale), "C") != 0)
            return false;
    return true;
}

/** Whether date and the C library turn every part of a format into the same text. */
bool isPlainFormat(char const* format, char const* known)
{
    while ((format = std::strchr(format, '%')) != nullptr) {
        ++format;
        if (*format == '-')
            ++format;
        if (*format == '\0' || !std::strchr(known, *format))
            return false;
        ++format;
    }
    return true;
}

bool isPlainLocale(locale_t locale)
{
    constexpr char const* known = "aAbBdeHIMpSTYZ";
    constexpr char const* knownAndTwelveHours = "aAbBdeHIMpSTYZr";
    return isPlainFormat(nl_langinfo_l(_DATE_FMT, locale), knownAndTwelveHours) &&
           isPlainFormat(nl_langinfo_l(T_FMT_AMPM, locale), known);
}

/** Libraries keep what they once read, a new process reads it anew: they agree on old files only.
 */
bool isAbsentOrOld(std::string const& path)
{
    std::optional<FileStamp> const stamp = FileStamp::of(path.c_str());
    return !stamp || stamp->isOlderThanProcess();
}

bool isLocaleDataOld()
{
    std::string const folder = "/usr/lib/locale";
    return isAbsentOrOld(folder) && isAbsentOrOld(folder + "/locale-archive");
}

/** Without TZ the C library looks at the system's own zone file each time. */
bool isZoneDataOld()
{
    char const* zone = std::getenv("TZ");
    if (!zone)
        return true;
    if (*zone == ':')
        ++zone;
    std::string const folder = "/usr/share/zoneinfo/";
    return isAbsentOrOld(*zone == '/' ? zone : folder + zone) &&
           isAbsentOrOld(folder + "posixrules");
}

} // namespace

Answer date()
{
    // Not time(), whose clock lags behind by a tick.
    timespec now{};
    clock_gettime(CLOCK_REALTIME, &now);
    return dateAt(now.tv_sec);
}

Answer dateAt(std::time_t now)
{
    if (!isZoneDataOld())
        return Answer::none("the time zone's data is newer than the process");
    Locale locale(newlocale(LC_ALL_MASK, "", nullptr));
    if (!(locale && isBuiltIn(locale.get())) && !isLocaleDataOld())
        return Answer::none("the locale's data is newer than the process");
    // Where a part of a locale cannot be had, programs stay with the built-in one as a whole.
    if (!locale)
        locale.reset(newlocale(LC_ALL_MASK, "C", nullptr));
    if (!locale || !isPlainLocale(locale.get()))
        return Answer::none("the locale writes dates in a way of its own");
    tzset();
    std::tm local{};
    std::array<char, 1024> text{};
    if (!localtime_r(&now, &local))
        return Answer::none("the time is out of range");
    std::string const format = nl_langinfo_l(_DATE_FMT, locale.get());
    std::size_t const length =
        strftime_l(text.data(), text.size(), (format + '\n').c_str(), &local, locale.get());
    if (length == 0)
        return Answer::none("the date is too long");
    return Answer::with({text.data(), length});
}

} // namespace miaccel
