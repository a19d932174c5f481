#pragma once
// Shared part of the GUI controllers of the Transmitter, Comma Detect,
// Receiver and Clock Correction pages: validated line edits, the m_active
// guard, UpdateData, and the default behaviour of the dialog's hooks.
//
// How a page GUI uses it:
//
//   class Qvz_MGTFooGui : public Qvz_MGTPageGui {
//       Q_OBJECT
//   public:
//       Qvz_MGTFooGui(Qvz_MGTFoo* page, QWidget* parent);
//       void LoadComboBoxes(Qvz_Block* block) override;
//       void DataToWidgets() override;
//       void WidgetsToData() override;
//   public slots:
//       // The seven shared slots, declared again here and in this order,
//       // before the page's own slots: moc lists only the slots a class
//       // declares itself, so this is what puts them first in the
//       // controller's QMetaObject. Each forwards to this base (or does the
//       // page's own thing where that page differs, e.g. a Back that
//       // writes nothing).
//       void onActive() override { Qvz_MGTPageGui::onActive(); }
//       bool onCancel() override { return Qvz_MGTPageGui::onCancel(); }
//       bool onBack() override { return Qvz_MGTPageGui::onBack(); }
//       bool onNext() override { return Qvz_MGTPageGui::onNext(); }
//       bool onFinish() override { return Qvz_MGTPageGui::onFinish(); }
//       void onMoreInfo() override { Qvz_MGTPageGui::onMoreInfo(); }
//       void init() override { Qvz_MGTPageGui::init(); }
//       void OnSomething();           // the page's own slots follow
//       void ValidateLE_ALL() {}
//   protected:
//       bool ReadPage() override { return m_pPage && m_pPage->ReadWizData(); }
//       bool WritePage() override { return m_pPage && m_pPage->WriteWizData(); }
//       void UpdateControls() override;
//   };
//
// The constructor passes the page, the parent, the number of validated
// entries and the help key to this base, builds its form, calls
// SetPageForm(title, form), makes its connections, then SetupEntry() for each
// validated entry in index order and ConnectEntries(this, &Qvz_MGTFooGui::
// ValidateLE_ALL). The page's ReadWizData calls LoadComboBoxes(block) and
// UpdateData(false) in window runs.

#include "Port_StringBase.h"
#include "Wg_WizardPage.h"

#include <QComboBox>
#include <QLineEdit>

#include <initializer_list>
#include <vector>

class Qvz_Attribute;
class Qvz_Block;
class Qvz_MGTWizPage;

class Qvz_MGTPageGui : public Wg_WizardPage {
    Q_OBJECT
public:
    // A line edit whose text must match a pattern, and what to say when not.
    struct LEValidator {
        QLineEdit* m_pLineEdit = nullptr;
        Port::StringBase m_message;

        // Attaches a case-sensitive whole-text validator for pattern to
        // lineEdit (replacing one set up earlier) and keeps both.
        void Setup(QLineEdit* lineEdit, const char* pattern, const Port::StringBase& message);
    };

    Qvz_MGTPageGui(Qvz_MGTWizPage* page, QWidget* parent, int entryCount,
                   const Port::StringBase& helpKey);
    ~Qvz_MGTPageGui() override;

    // save false: fields into the form; true: the form into the fields.
    void UpdateData(bool save);
    virtual void DataToWidgets() = 0;
    virtual void WidgetsToData() = 0;
    // Refills the form's lists from the block's legal values.
    virtual void LoadComboBoxes(Qvz_Block* /*block*/) {}

    bool isAdvanced() override { return false; }

    // The shared behaviour of the dialog's hooks (see the header comment).
    // Re-reads the block into the form with the slots quiet, then enables
    // More Info.
    void onActive() override;
    bool onCancel() override { return true; }
    // Writes without checking the entries.
    bool onBack() override;
    // Checks the enabled entries, then writes.
    bool onNext() override;
    // Writes without checking; true (stay) when the write fails.
    bool onFinish() override;
    void onMoreInfo() override;
    void init() override {}

    // Clears combo and fills it with the attribute's legal values in order;
    // a null attribute leaves it empty.
    static void FillComboBox(QComboBox* combo, const Qvz_Attribute* attribute);
    // field <- combo's current text; left as it is when the list offers
    // nothing, so that an empty list never blanks an attribute.
    static void ReadComboBox(const QComboBox* combo, Port::StringBase& field);

    int EntryCount() const { return static_cast<int>(m_entries.size()); }
    const LEValidator& Entry(int index) const;
    bool IsActive() const { return m_active; }

protected:
    // The page's ReadWizData and WriteWizData.
    virtual bool ReadPage() = 0;
    virtual bool WritePage() = 0;
    // The page's own enabling and showing, after each read in onActive.
    virtual void UpdateControls() {}

    void SetPageForm(const QString& title, QWidget* form);
    // Out-of-range indexes are ignored.
    void SetupEntry(int index, QLineEdit* lineEdit, const char* pattern,
                    const Port::StringBase& message);
    // Connects each entry's textChanged to slot (once, however often called).
    template <class Gui> void ConnectEntries(Gui* receiver, void (Gui::*slot)()) {
        for (const LEValidator& e : m_entries)
            if (e.m_pLineEdit)
                connect(e.m_pLineEdit, &QLineEdit::textChanged, receiver, slot,
                        Qt::UniqueConnection);
    }
    // The first enabled entry without acceptable input gets its message and
    // the focus; false then. Entries hidden in the form are passed over: the
    // user could neither see the message's entry nor correct it.
    bool CheckEntries();
    // The active block of the page's design data, or null.
    Qvz_Block* ActiveBlock() const;
    void EnableMoreInfo();

    // The controls of one attribute: hidden when attr is absent, else shown
    // and enabled when on and attr is editable. Null widgets are skipped.
    static void ApplyAttrRow(const Qvz_Attribute* attr, bool on,
                             std::initializer_list<QWidget*> widgets);
    // Present and editable.
    static bool IsEditable(const Qvz_Attribute* attr);
    static void EnableAll(std::initializer_list<QWidget*> widgets, bool on);
    static void ShowAll(std::initializer_list<QWidget*> widgets, bool on);
    // An entry's text as attribute text; the validators admit ASCII only.
    static Port::StringBase EntryText(const QLineEdit* edit);

    std::vector<LEValidator> m_entries;
    Qvz_MGTWizPage* m_pBasePage = nullptr;
    // False while the controller itself loads the widgets, so that the
    // widgets' change slots leave the fields alone.
    bool m_active = false;

private:
    Port::StringBase m_helpKey;
};
