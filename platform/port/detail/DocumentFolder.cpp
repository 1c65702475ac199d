#include "platform/port/detail/DocumentFolder.h"

#include <algorithm>
#include <iterator>

namespace Port::detail {

namespace {

constexpr const char* americanEnglish = "usenglish";

struct Folder {
    int language;
    const char* name;
};

/// By whole numbers of languages, which go before those below.
constexpr Folder variants[] = {
    {0x0404, "traditionalchinese"},
    {0x0C04, "traditionalchinese"},
    {0x1404, "traditionalchinese"},
    {0x041A, "croatian"},
};

/// By the primary numbers of languages.
constexpr Folder folders[] = {
    {0x01, "arabic"},      {0x02, "bulgarian"},  {0x03, "catalan"},    {0x04, "chinese"},    {0x05, "czech"},
    {0x06, "danish"},      {0x07, "german"},     {0x08, "greek"},      {0x0A, "spanish"},    {0x0B, "finnish"},
    {0x0C, "french"},      {0x0D, "hebrew"},     {0x0E, "hungarian"},  {0x0F, "icelandic"},  {0x10, "italian"},
    {0x11, "japanese"},    {0x12, "korean"},     {0x13, "dutch"},      {0x14, "norwegian"},  {0x15, "polish"},
    {0x16, "portuguese"},  {0x18, "romanian"},   {0x19, "russian"},    {0x1A, "serbian"},    {0x1B, "slovak"},
    {0x1C, "albanian"},    {0x1D, "swedish"},    {0x1E, "thai"},       {0x1F, "turkish"},    {0x20, "urdu"},
    {0x21, "indonesian"},  {0x22, "ukrainian"},  {0x23, "belarusian"}, {0x24, "slovenian"},  {0x25, "estonian"},
    {0x26, "latvian"},     {0x27, "lithuanian"}, {0x29, "persian"},    {0x2A, "vietnamese"}, {0x2B, "armenian"},
    {0x2C, "azerbaijani"}, {0x2D, "basque"},     {0x2F, "macedonian"}, {0x36, "afrikaans"},  {0x37, "georgian"},
    {0x38, "faroese"},     {0x39, "hindi"},      {0x3E, "malay"},      {0x3F, "kazakh"},     {0x41, "swahili"},
    {0x43, "uzbek"},       {0x44, "tatar"},      {0x45, "bengali"},    {0x46, "punjabi"},    {0x47, "gujarati"},
    {0x49, "tamil"},       {0x4A, "telugu"},     {0x4B, "kannada"},    {0x4E, "marathi"},    {0x50, "mongolian"},
    {0x56, "galician"},    {0x57, "konkani"},
};

template <std::size_t count>
const char* named(const Folder (&table)[count], int language) {
    const auto* const found = std::ranges::find(table, language, &Folder::language);
    return found == std::end(table) ? nullptr : found->name;
}

} // namespace

const char* documentFolder(LCID locale) {
    const LANGID language = LANGIDFROMLCID(locale);
    if (const char* name = named(variants, language)) {
        return name;
    }
    const char* const name = named(folders, PRIMARYLANGID(language));
    return name ? name : americanEnglish;
}

} // namespace Port::detail
