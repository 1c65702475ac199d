#include "NotesPreferences.h"

#include "Notes.h"

CNotesPreferences::CNotesPreferences(CWnd* parent) : CPreferences(parent) {
    AddFamilyPages();
}

void CNotesPreferences::EditKeys() {
    theApp.GetKeyboard().Edit();
}

int CNotesPreferences::CountOwnKeys() const {
    return theApp.GetKeyboard().CountOwn();
}

void CNotesPreferences::ResetKeys() {
    theApp.GetKeyboard().Reset();
}
