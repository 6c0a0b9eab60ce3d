#pragma once

#include <plist/plist.h>

#include <clocale>
#include <cstdlib>
#include <locale.h>
#include <memory>

namespace pelorus {

// libplist's handles with owners. For the property-list sources only.

struct PlistNodeDeleter {
    void operator()(void* node) const { plist_free(node); }
};
using PlistNode = std::unique_ptr<void, PlistNodeDeleter>;

struct FreeDeleter {
    void operator()(void* memory) const { std::free(memory); }
};
using PlistIterator = std::unique_ptr<void, FreeDeleter>;
using PlistText = std::unique_ptr<char, FreeDeleter>;

/// libplist reads and writes the reals of XML with the locale's decimal point. While one of these lives the
/// calling thread has the point that XML has.
class XmlNumberLocale {
public:
    XmlNumberLocale() : previous(uselocale(classic())) {}
    ~XmlNumberLocale() { uselocale(previous); }
    XmlNumberLocale(const XmlNumberLocale&) = delete;
    XmlNumberLocale& operator=(const XmlNumberLocale&) = delete;

private:
    static locale_t classic()
    {
        static const locale_t locale = newlocale(LC_ALL_MASK, "C", locale_t{});
        return locale;
    }

    locale_t previous;
};

} // namespace pelorus
