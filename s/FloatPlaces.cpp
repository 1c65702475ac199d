#include "s/FloatPlaces.h"

#include "platform/win/Registry.h"
#include "s/ExternFrame.h"
#include "s/Profile.h"

#include <algorithm>
#include <map>

namespace {

struct Place {
    CRect rect;
    bool isKnown = false;
    bool isChanged = false;
};

std::map<unsigned int, Place>& places() {
    static auto* all = new std::map<unsigned int, Place>;
    return *all;
}

CString entryOf(unsigned int resourceId) {
    CString entry;
    entry.Format("FloatPlacement%u", resourceId);
    return entry;
}

/// The settings are asked for each number once.
const Place& placeOf(unsigned int resourceId) {
    const auto found = places().find(resourceId);
    if (found != places().end()) {
        return found->second;
    }
    Place place;
    WINDOWPLACEMENT stored{};
    if (Gui_Profile::ReadWindowPlacement(stored, entryOf(resourceId), nullptr)) {
        place.rect = stored.rcNormalPosition;
        place.isKnown = true;
    }
    return places()[resourceId] = place;
}

bool isTaken(const CRect& place, const CFrameWnd& except) {
    const auto& frames = Gui_ExternFrame::GetAll();
    return std::any_of(frames.begin(), frames.end(), [&](const Gui_ExternFrame* frame) {
        CRect rect;
        frame->GetWindowRect(&rect);
        return frame != &except && frame->IsWindowVisible() && rect.TopLeft() == place.TopLeft();
    });
}

} // namespace

void FloatPlaces::show(CFrameWnd& frame, unsigned int resourceId, const CRect& from) {
    constexpr int step = 26; // a caption's height, so that the one behind can be read
    const Place& known = placeOf(resourceId);
    CRect rect = known.isKnown ? known.rect : from + CPoint(step, step);
    rect.right = std::max<int>(rect.right, rect.left + 320);
    rect.bottom = std::max<int>(rect.bottom, rect.top + 240);
    for (int tries = 0; tries < 20 && isTaken(rect, frame); ++tries) {
        rect += CPoint(step, step);
    }
    WINDOWPLACEMENT placement{};
    placement.length = sizeof placement;
    placement.showCmd = SW_SHOWNORMAL;
    placement.rcNormalPosition = rect;
    if (!frame.SetWindowPlacement(&placement)) {
        frame.ShowWindow(SW_SHOWNORMAL);
    }
}

void FloatPlaces::remember(const CFrameWnd& frame, unsigned int resourceId) {
    WINDOWPLACEMENT placement{};
    placement.length = sizeof placement;
    if (!frame.IsWindowVisible() || !frame.GetWindowPlacement(&placement)) {
        return;
    }
    const CRect rect = placement.rcNormalPosition;
    Place& place = places()[resourceId];
    place.isChanged = place.isChanged || !place.isKnown || rect != place.rect;
    place.rect = rect;
    place.isKnown = true;
}

void FloatPlaces::save() {
    tvx::RegistryTransaction together;
    const bool any =
        std::any_of(places().begin(), places().end(), [](const auto& entry) { return entry.second.isChanged; });
    if (!any || together.begin() != ERROR_SUCCESS) {
        return;
    }
    for (auto& [resourceId, place] : places()) {
        if (std::exchange(place.isChanged, false)) {
            WINDOWPLACEMENT placement{};
            placement.length = sizeof placement;
            placement.showCmd = SW_SHOWNORMAL;
            placement.rcNormalPosition = place.rect;
            Gui_Profile::WriteWindowPlacement(placement, entryOf(resourceId), nullptr);
        }
    }
    (void)together.commit();
}
