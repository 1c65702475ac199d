#pragma once

#include "afxcoll.h"
#include "afxwin.h"
#include "s/Accel.h"
#include "s/Export.h"

#include <memory>

/// The table inside of an accelerator map: Gui_Accel::EncodeFlagsAndKey to command.
class GUI_API Gui_AccelMapImpl : public CMapPtrToWord {
public:
    Gui_AccelMapImpl();
    ~Gui_AccelMapImpl() override;
};

/// The accelerators of a frame in a form that can be changed and asked: which command has a key, which keys has a
/// command. It writes the names of keys into menus.
///
/// @code
/// Gui_AccelMap map(frame->m_hAccelTable);
/// map.Add(Gui_Accel(FVIRTKEY | FCONTROL, 'G', ID_VIEW_GRID)); // whoever had Ctrl+G has it no longer
/// frame->m_hAccelTable = map.CreateTable();
/// map.AnnotateMenu(frame->GetMenu());                         // "&Grid\tCtrl+G"
/// @endcode
///
/// A key has one command, a command any number of keys. FNOINVERT makes no difference between keys; every accelerator
/// that comes out of a map has it. Accelerators come out in the order of their packed keys, however the map was filled.
class GUI_API Gui_AccelMap {
public:
    /// No accelerators.
    Gui_AccelMap();
    /// As AddAll.
    Gui_AccelMap(HACCEL table);
    /// As AddAll.
    Gui_AccelMap(const tagACCEL* accels, int count);
    Gui_AccelMap(const Gui_AccelMap& other);
    ~Gui_AccelMap();
    Gui_AccelMap& operator=(const Gui_AccelMap& other);

    /// Gives a key to a command; whatever command had it loses it.
    void Add(const Gui_Accel& accel);
    /// Adds accelerators one by one: a later one takes the key of an earlier one.
    /// @param accels  copied; null adds nothing
    void AddAll(const tagACCEL* accels, int count);
    /// Adds those of a table, which stays the caller's. Null, and what is no table, adds nothing.
    void AddAll(HACCEL table);
    /// Removes all keys of a command.
    void Remove(unsigned short command);
    /// Removes a key, whatever command has it.
    void Remove(const Gui_Accel& accel);
    /// Removes all keys.
    void RemoveAll();

    /// Finds the command of a key.
    /// @param command  receives it; 0 when nobody has the key
    /// @return 1 or 0
    int GetCmdAt(const Gui_Accel& accel, unsigned short& command) const;
    /// Finds a key of a command.
    /// @param index  counted from 0
    /// @param accel  receives flags, key and command; cleared when the command has no such key
    /// @return 1 or 0
    int GetAccelAt(unsigned short command, int index, Gui_Accel& accel) const;
    /// All accelerators.
    /// @param count  receives their number
    /// @param table  receives a new array of them, which the caller deletes by delete[]; null when there are none, and
    ///               when the heap is exhausted, with a count of 0
    void GetAll(int& count, tagACCEL*& table) const;
    /// Whether another map has the same accelerators.
    bool IsSame(const Gui_AccelMap& other) const;
    /// A new table with all accelerators, which the caller destroys by DestroyAcceleratorTable. Null when there are
    /// none.
    HACCEL CreateTable() const;

    /// Writes into the items of a menu and its popups which keys they have: an item whose shortcut is a key of its
    /// command keeps it, another one gets the first of the command's keys, and none where the command has none. Each
    /// command's item is made anew with its text, of which 99 characters are kept: check marks and the like are set
    /// again when the menu is next opened.
    /// @param menu  null changes nothing
    void AnnotateMenu(CMenu* menu) const;

private:
    std::unique_ptr<Gui_AccelMapImpl> m_impl;
};
