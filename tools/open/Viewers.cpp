#include "tools/open/Viewers.h"

#include <algorithm>
#include <array>
#include <cctype>

namespace opening {

namespace {

/// How a viewer takes a page or a named place.
enum class Way {
    None,
    Option,  ///< an option and the value in one word
    Option2, ///< an option, and the value as the next word
    Behind,  ///< a word behind the document
    InName,  ///< behind the document's name
    Address, ///< behind the document's address
};

struct Form {
    Way way = Way::None;
    std::string_view text; ///< the option, or what stands before the value
};

struct Viewer {
    std::string_view program;
    Form page; ///< for the number of a page, the first being 1
    Form name; ///< for a named place
};

constexpr Form indexOption{Way::Option, "--page-index="};
constexpr Form destinationOption{Way::Option, "--named-dest="};
constexpr Form pageAddress{Way::Address, "page="};
constexpr Form nameAddress{Way::Address, "nameddest="};

/// As their manuals say.
constexpr std::array<Viewer, 34> viewers{{
    {"evince", indexOption, destinationOption},
    {"papers", indexOption, destinationOption},
    {"xreader", indexOption, destinationOption},
    {"atril", indexOption, {}},
    {"okular", {Way::Option2, "--page"}, {Way::Address, ""}},
    {"zathura", {Way::Option, "--page="}, {}},
    {"mupdf", {Way::Behind, ""}, {}},
    {"mupdf-gl", {Way::Behind, ""}, {}},
    {"mupdf-x11", {Way::Behind, ""}, {}},
    {"xpdf", {Way::Behind, ""}, {Way::Behind, "+"}},
    {"qpdfview", {Way::InName, "#"}, {}},
    {"firefox", pageAddress, nameAddress},
    {"firefox-esr", pageAddress, nameAddress},
    {"librewolf", pageAddress, nameAddress},
    {"chromium", pageAddress, nameAddress},
    {"chromium-browser", pageAddress, nameAddress},
    {"chrome", pageAddress, nameAddress},
    {"google-chrome", pageAddress, nameAddress},
    {"google-chrome-stable", pageAddress, nameAddress},
    {"brave", pageAddress, nameAddress},
    {"brave-browser", pageAddress, nameAddress},
    {"vivaldi", pageAddress, nameAddress},
    {"vivaldi-stable", pageAddress, nameAddress},
    {"opera", pageAddress, nameAddress},
    {"microsoft-edge", pageAddress, nameAddress},
    {"microsoft-edge-stable", pageAddress, nameAddress},
    {"epiphany", pageAddress, nameAddress},
    {"epiphany-browser", pageAddress, nameAddress},
    {"falkon", pageAddress, nameAddress},
    {"konqueror", pageAddress, nameAddress},
    {"x-www-browser", pageAddress, nameAddress},
    {"gnome-www-browser", pageAddress, nameAddress},
    {"www-browser", pageAddress, nameAddress},
    {"sensible-browser", pageAddress, nameAddress},
}};

const Viewer* viewerOf(std::string_view program) {
    const auto found = std::ranges::find(viewers, program, &Viewer::program);
    return found != viewers.end() ? found : nullptr;
}

/// A part of a place such as "page=12&zoom=100"; empty when there is none of that name.
std::string parameter(const std::string& place, std::string_view name) {
    for (std::size_t at = 0; at < place.size();) {
        const std::size_t end = std::min(place.find_first_of("&#", at), place.size());
        if (place.compare(at, name.size(), name) == 0) {
            return place.substr(at + name.size(), end - at - name.size());
        }
        at = end + 1;
    }
    return {};
}

std::string pageOf(const std::string& place) {
    const std::string page = parameter(place, "page=");
    const bool isNumber = std::ranges::all_of(page, [](unsigned char digit) { return std::isdigit(digit) != 0; });
    return isNumber ? page : std::string();
}

/// A place without "=" is a name by itself.
std::string nameOf(const std::string& place) {
    return place.find('=') == std::string::npos ? place : parameter(place, "nameddest=");
}

void apply(PaperCall& call, const Form& form, const std::string& value, const Document& document) {
    const std::string text = std::string(form.text) + value;
    switch (form.way) {
    case Way::None:
        break;
    case Way::Option:
        call.before = {text};
        break;
    case Way::Option2:
        call.before = {std::string(form.text), value};
        break;
    case Way::Behind:
        call.behind = {text};
        break;
    case Way::InName:
        call.document += text;
        break;
    case Way::Address: {
        Document placed = document;
        placed.place = text;
        call.document = placed.address();
        break;
    }
    }
}

} // namespace

bool isPaper(const Document& document) {
    constexpr std::string_view extension = ".pdf";
    return document.file.size() > extension.size() &&
           std::equal(extension.rbegin(), extension.rend(), document.file.rbegin(),
                      [](char left, unsigned char right) { return left == std::tolower(right); });
}

PaperCall paperCall(const Document& document, std::string_view program) {
    PaperCall call{document.file, {}, {}};
    const Viewer* viewer = viewerOf(program);
    const std::string page = pageOf(document.place);
    const std::string name = nameOf(document.place);
    if (viewer && !page.empty()) {
        apply(call, viewer->page, page, document);
    } else if (viewer && !name.empty()) {
        apply(call, viewer->name, name, document);
    }
    return call;
}

bool isKnownViewer(std::string_view program) {
    return viewerOf(program) != nullptr;
}

} // namespace opening
