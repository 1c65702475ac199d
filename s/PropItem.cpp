#include "s/PropItem.h"

#include "s/PropSheet.h"
#include "s/Record.h"

struct Gui_PropItem::Record {
    std::unique_ptr<CWnd> cachedPage;
    CreatePageFunction createPage;
    NotifyPageFunction notifyPage;
    Port::StringBase<char> name;
    Port::StringBase<char> pageTitle;
    Port::StringBase<char> pageSubTitle;
    Gui_PropItem* parentItem;
    Gui_PropSheet* propSheet;
    InitialState initialState;

    Port::StringBase<char> keywords;
    DefaultsFunction defaults;
    bool changed;
};

Gui_PropItem::Gui_PropItem(const Port::StringBase<char>& name, CreatePageFunction createPage,
                           NotifyPageFunction notifyPage, InitialState state)
    : m_record(MakeRecord<Record>(nullptr, createPage, notifyPage, name, "", "", nullptr, nullptr, state, "", nullptr,
                                  false)) {}

Gui_PropItem::~Gui_PropItem() = default;

// --- what it is ---

Port::StringBase<char> Gui_PropItem::GetName() const {
    return m_record->name;
}

Gui_PropItem::InitialState Gui_PropItem::GetInitialState() const {
    return m_record->initialState;
}

Gui_PropItem* Gui_PropItem::GetParentItem() const {
    return m_record->parentItem;
}

Gui_PropSheet* Gui_PropItem::GetPropSheet() const {
    return m_record->propSheet;
}

Port::StringBase<char> Gui_PropItem::GetPageTitle() {
    return m_record->pageTitle;
}

Port::StringBase<char> Gui_PropItem::GetPageSubTitle() {
    return m_record->pageSubTitle;
}

void Gui_PropItem::SetName(const Port::StringBase<char>& name) {
    m_record->name = name;
}

void Gui_PropItem::SetInitialState(InitialState state) {
    m_record->initialState = state;
}

void Gui_PropItem::SetParentItem(Gui_PropItem* parent) {
    m_record->parentItem = parent;
}

void Gui_PropItem::SetPropSheet(Gui_PropSheet* sheet) {
    m_record->propSheet = sheet;
}

void Gui_PropItem::SetPageTitle(const Port::StringBase<char>& title) {
    m_record->pageTitle = title;
}

void Gui_PropItem::SetPageSubTitle(const Port::StringBase<char>& subTitle) {
    m_record->pageSubTitle = subTitle;
}

// --- the page ---

CWnd* Gui_PropItem::GetPage() {
    CWnd* page = GetCachedPage();
    if (!page) {
        page = CreatePage();
        if (page) {
            SetCachedPage(page);
        }
    }
    return page;
}

CWnd* Gui_PropItem::GetCachedPage() {
    return m_record->cachedPage.get();
}

void Gui_PropItem::SetCachedPage(CWnd* page) {
    (void)m_record->cachedPage.release(); // the caller's
    m_record->cachedPage.reset(page);
}

CWnd* Gui_PropItem::CreatePage() {
    return m_record->createPage ? m_record->createPage(this, GetPropSheet()) : nullptr;
}

// --- notifications ---

void Gui_PropItem::notify(Notification what) {
    CWnd* page = GetPage();
    if (m_record->notifyPage) {
        m_record->notifyPage(this, page, what);
    }
}

void Gui_PropItem::ActivatePage() {
    notify(NotifyActivate);
}

void Gui_PropItem::ReactivatePage() {
    notify(NotifyReactivate);
}

void Gui_PropItem::DeactivatePage() {
    notify(NotifyDeactivate);
}

void Gui_PropItem::ApplyPageChanges() {
    notify(NotifyApply);
}

void Gui_PropItem::ShowHelp() {
    notify(NotifyHelp);
}

void Gui_PropItem::SetFocusFirst() {
    notify(NotifyFocusFirst);
}

void Gui_PropItem::SetFocusLast() {
    notify(NotifyFocusLast);
}

// --- functions of the host ---

Gui_PropItem::CreatePageFunction Gui_PropItem::GetCreatePageFunction() const {
    return m_record->createPage;
}

Gui_PropItem::NotifyPageFunction Gui_PropItem::GetNotifyPageFunction() const {
    return m_record->notifyPage;
}

void Gui_PropItem::SetCreatePageFunction(CreatePageFunction createPage) {
    m_record->createPage = createPage;
}

void Gui_PropItem::SetNotifyPageFunction(NotifyPageFunction notifyPage) {
    m_record->notifyPage = notifyPage;
}

// --- what the sheet makes of it ---

void Gui_PropItem::SetKeywords(const Port::StringBase<char>& keywords) {
    m_record->keywords = keywords;
}

Port::StringBase<char> Gui_PropItem::GetKeywords() const {
    return m_record->keywords;
}

void Gui_PropItem::SetDefaultsFunction(DefaultsFunction defaults) {
    m_record->defaults = defaults;
    if (Gui_PropSheet* sheet = GetPropSheet()) {
        sheet->itemChanged(this);
    }
}

Gui_PropItem::DefaultsFunction Gui_PropItem::GetDefaultsFunction() const {
    return m_record->defaults;
}

void Gui_PropItem::SetChanged(bool changed) {
    if (changed == m_record->changed) {
        return;
    }
    m_record->changed = changed;
    if (Gui_PropSheet* sheet = GetPropSheet()) {
        sheet->itemChanged(this);
    }
}

bool Gui_PropItem::IsChanged() const {
    return m_record->changed;
}
