#pragma once

#include "samples/family/Preferences.h"

/// The preferences of Notes: those of the family.
class CNotesPreferences : public CPreferences {
public:
    explicit CNotesPreferences(CWnd* parent);

    void EditKeys() override;
    int CountOwnKeys() const override;
    void ResetKeys() override;

protected:
    void StoreOwn() override {}
};
