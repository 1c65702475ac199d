#include "platform/win/detail/LanguageTable.h"

#include <algorithm>
#include <string>

namespace tvx::detail {

namespace {

// Numbers and abbreviations: the platform's published list of locale identifiers with its column of abbreviated
// language names. Names: ISO 639 and ISO 3166, as the C library names its locales.
constexpr Language table[] = {
    {0x0401, "ar_SA", "ARA"},       {0x0801, "ar_IQ", "ARI"}, {0x0C01, "ar_EG", "ARE"}, {0x1001, "ar_LY", "ARL"},
    {0x1401, "ar_DZ", "ARG"},       {0x1801, "ar_MA", "ARM"}, {0x1C01, "ar_TN", "ART"}, {0x2001, "ar_OM", "ARO"},
    {0x2401, "ar_YE", "ARY"},       {0x2801, "ar_SY", "ARS"}, {0x2C01, "ar_JO", "ARJ"}, {0x3001, "ar_LB", "ARB"},
    {0x3401, "ar_KW", "ARK"},       {0x3801, "ar_AE", "ARU"}, {0x3C01, "ar_BH", "ARH"}, {0x4001, "ar_QA", "ARQ"},
    {0x0402, "bg_BG", "BGR"},       {0x0403, "ca_ES", "CAT"}, {0x0804, "zh_CN", "CHS"}, {0x0404, "zh_TW", "CHT"},
    {0x0C04, "zh_HK", "ZHH"},       {0x1004, "zh_SG", "ZHI"}, {0x1404, "zh_MO", "ZHM"}, {0x0405, "cs_CZ", "CSY"},
    {0x0406, "da_DK", "DAN"},       {0x0407, "de_DE", "DEU"}, {0x0807, "de_CH", "DES"}, {0x0C07, "de_AT", "DEA"},
    {0x1007, "de_LU", "DEL"},       {0x1407, "de_LI", "DEC"}, {0x0408, "el_GR", "ELL"}, {0x0409, "en_US", "ENU"},
    {0x0809, "en_GB", "ENG"},       {0x0C09, "en_AU", "ENA"}, {0x1009, "en_CA", "ENC"}, {0x1409, "en_NZ", "ENZ"},
    {0x1809, "en_IE", "ENI"},       {0x1C09, "en_ZA", "ENS"}, {0x2009, "en_JM", "ENJ"}, {0x2809, "en_BZ", "ENL"},
    {0x2C09, "en_TT", "ENT"},       {0x3009, "en_ZW", "ENW"}, {0x3409, "en_PH", "ENP"}, {0x0C0A, "es_ES", "ESN"},
    {0x080A, "es_MX", "ESM"},       {0x100A, "es_GT", "ESG"}, {0x140A, "es_CR", "ESC"}, {0x180A, "es_PA", "ESA"},
    {0x1C0A, "es_DO", "ESD"},       {0x200A, "es_VE", "ESV"}, {0x240A, "es_CO", "ESO"}, {0x280A, "es_PE", "ESR"},
    {0x2C0A, "es_AR", "ESS"},       {0x300A, "es_EC", "ESF"}, {0x340A, "es_CL", "ESL"}, {0x380A, "es_UY", "ESY"},
    {0x3C0A, "es_PY", "ESZ"},       {0x400A, "es_BO", "ESB"}, {0x440A, "es_SV", "ESE"}, {0x480A, "es_HN", "ESH"},
    {0x4C0A, "es_NI", "ESI"},       {0x500A, "es_PR", "ESU"}, {0x040B, "fi_FI", "FIN"}, {0x040C, "fr_FR", "FRA"},
    {0x080C, "fr_BE", "FRB"},       {0x0C0C, "fr_CA", "FRC"}, {0x100C, "fr_CH", "FRS"}, {0x140C, "fr_LU", "FRL"},
    {0x180C, "fr_MC", "FRM"},       {0x040D, "he_IL", "HEB"}, {0x040E, "hu_HU", "HUN"}, {0x040F, "is_IS", "ISL"},
    {0x0410, "it_IT", "ITA"},       {0x0810, "it_CH", "ITS"}, {0x0411, "ja_JP", "JPN"}, {0x0412, "ko_KR", "KOR"},
    {0x0413, "nl_NL", "NLD"},       {0x0813, "nl_BE", "NLB"}, {0x0414, "nb_NO", "NOR"}, {0x0414, "no_NO", "NOR"},
    {0x0814, "nn_NO", "NON"},       {0x0415, "pl_PL", "PLK"}, {0x0416, "pt_BR", "PTB"}, {0x0816, "pt_PT", "PTG"},
    {0x0418, "ro_RO", "ROM"},       {0x0419, "ru_RU", "RUS"}, {0x041A, "hr_HR", "HRV"}, {0x0C1A, "sr_RS", "SRB"},
    {0x081A, "sr_RS@latin", "SRL"}, {0x041B, "sk_SK", "SKY"}, {0x041C, "sq_AL", "SQI"}, {0x041D, "sv_SE", "SVE"},
    {0x081D, "sv_FI", "SVF"},       {0x041E, "th_TH", "THA"}, {0x041F, "tr_TR", "TRK"}, {0x0420, "ur_PK", "URP"},
    {0x0421, "id_ID", "IND"},       {0x0422, "uk_UA", "UKR"}, {0x0423, "be_BY", "BEL"}, {0x0424, "sl_SI", "SLV"},
    {0x0425, "et_EE", "ETI"},       {0x0426, "lv_LV", "LVI"}, {0x0427, "lt_LT", "LTH"}, {0x0429, "fa_IR", "FAR"},
    {0x042A, "vi_VN", "VIT"},       {0x042B, "hy_AM", "HYE"}, {0x042C, "az_AZ", "AZE"}, {0x042D, "eu_ES", "EUQ"},
    {0x042F, "mk_MK", "MKI"},       {0x0436, "af_ZA", "AFK"}, {0x0437, "ka_GE", "KAT"}, {0x0438, "fo_FO", "FOS"},
    {0x0439, "hi_IN", "HIN"},       {0x043E, "ms_MY", "MSL"}, {0x083E, "ms_BN", "MSB"}, {0x043F, "kk_KZ", "KKZ"},
    {0x0441, "sw_KE", "SWK"},       {0x0443, "uz_UZ", "UZB"}, {0x0444, "tt_RU", "TTT"}, {0x0445, "bn_IN", "BNG"},
    {0x0446, "pa_IN", "PAN"},       {0x0447, "gu_IN", "GUJ"}, {0x0449, "ta_IN", "TAM"}, {0x044A, "te_IN", "TEL"},
    {0x044B, "kn_IN", "KAN"},       {0x044E, "mr_IN", "MAR"}, {0x0450, "mn_MN", "MON"}, {0x0456, "gl_ES", "GLC"},
    {0x0457, "kok_IN", "KNK"},
};

const Language* exactly(std::string_view name) {
    const auto* found = std::ranges::find(table, name, &Language::name);
    return found == std::end(table) ? nullptr : found;
}

} // namespace

std::span<const Language> languages() {
    return table;
}

const Language* languageNamed(std::string_view name) {
    if (const Language* language = exactly(name)) {
        return language;
    }
    if (const Language* language = exactly(name.substr(0, name.find('@')))) {
        return language;
    }
    const std::string start = std::string(name.substr(0, name.find_first_of("_@"))) + '_';
    const auto* found = std::ranges::find_if(
        table, [&](const Language& language) { return std::string_view(language.name).starts_with(start); });
    return found == std::end(table) ? nullptr : found;
}

const Language* languageOf(LCID locale) {
    const auto* found = std::ranges::find(table, locale, &Language::id);
    return found == std::end(table) ? nullptr : found;
}

} // namespace tvx::detail
