// Windows language identifiers of the keyboard languages, shared by the backends that learn
// the language as a locale.
#include "platform/Backends.h"

#include <QLocale>

namespace Velmar::Private::Platform {

namespace {

struct LanguageId {
    QLocale::Language language;
    int id;
};

// Primary languages with their default sublanguage, as Windows numbers them.
const LanguageId kLanguageIds[] = {
    {QLocale::English, 0x0409}, {QLocale::French, 0x040C}, {QLocale::German, 0x0407},
    {QLocale::Italian, 0x0410}, {QLocale::Spanish, 0x0C0A}, {QLocale::Dutch, 0x0413},
    {QLocale::Portuguese, 0x0416}, {QLocale::Swedish, 0x041D}, {QLocale::Danish, 0x0406},
    {QLocale::NorwegianBokmal, 0x0414}, {QLocale::Finnish, 0x040B}, {QLocale::Polish, 0x0415},
    {QLocale::Czech, 0x0405}, {QLocale::Russian, 0x0419}, {QLocale::Japanese, 0x0411},
    {QLocale::Korean, 0x0412}, {QLocale::Chinese, 0x0804}, {QLocale::Greek, 0x0408},
    {QLocale::Turkish, 0x041F}, {QLocale::Hungarian, 0x040E},
};

} // namespace

int languageIdForLocale(const QLocale& locale)
{
    for (const LanguageId& entry : kLanguageIds) {
        if (entry.language == locale.language())
            return entry.id;
    }
    return 0x0409;
}

} // namespace Velmar::Private::Platform
