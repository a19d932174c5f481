#pragma once
// Design data built in memory for the General Setup tests, and a page that
// opens its internal steps to them.

#include "Qvz_MGTGeneralSetup.h"
#include "Qvz_MGTWizMain.h"

#include "TestApp.h"

#include <QApplication>
#include <QString>
#include <QStringList>

#include <memory>
#include <string>
#include <vector>

inline QApplication& App() {
    return TestApp();
}

class TestPage : public Qvz_MGTGeneralSetup {
public:
    using Qvz_MGTGeneralSetup::EnableDependentPages;
    using Qvz_MGTGeneralSetup::EnablePages;
    using Qvz_MGTGeneralSetup::FindBlock;
    using Qvz_MGTGeneralSetup::FixBlockInstanceName;
    using Qvz_MGTGeneralSetup::MigrateOldAttributes;
    using Qvz_MGTGeneralSetup::Qvz_MGTGeneralSetup;
    using Qvz_MGTGeneralSetup::Rename3GIOBlock;
    using Qvz_MGTGeneralSetup::SetPinWidths;
};

// Adds an attribute; legal is a comma-separated list, def the default
// (the value when null).
inline Qvz_Attribute* Attr(Qvz_Block* b, const char* name, const char* value,
                           const char* def = nullptr, const char* legal = nullptr,
                           bool editable = true) {
    Qvz_Attribute* a = b->AddAttribute(name, value);
    if (def)
        a->SetDefaultValue(def);
    if (legal)
        for (const QString& v : QString(legal).split(',', Qt::SkipEmptyParts))
            a->GetLegalValues().Add(StringBase::FromQString(v));
    a->SetEditable(editable);
    return a;
}

inline Qvz_Pin* Pin(Qvz_Block* b, const char* name, int width, bool dataWidth = false,
                    const char* dir = "IN") {
    Qvz_Pin* p = b->AddPin(name, dir);
    p->SetWidth(width);
    p->SetSupportsDataWidth(dataWidth);
    return p;
}

// Design data with a wizard main attached; families as given.
struct Design {
    Qvz_WizData data;
    Qvz_MGTWizMain main{"Velomux Wizard", false};

    Design(bool gt, bool gt10, bool gt11, const char* fileName = "top") {
        data.Target().supportsGT = gt;
        data.Target().supportsGT10 = gt10;
        data.Target().supportsGT11 = gt11;
        data.Target().fileName = fileName;
    }

    Qvz_Block* Block(const char* name, const char* prim, const char* display = nullptr,
                     const char* widthAttr = nullptr, const char* width = nullptr,
                     bool used = false) {
        auto b = std::make_unique<Qvz_Block>(name, prim, Qvz_FamilyOfPrimitive(prim));
        if (display)
            b->AddAttribute("MGT_DISPLAY_NAME", display);
        if (widthAttr)
            Attr(b.get(), widthAttr, width, nullptr, "1,2,4,8");
        b->SetIsUsed(used);
        return data.AddBlock(std::move(b));
    }

    // The main takes the data (and its families); batch by default.
    Qvz_MGTWizMain& Main(bool batch = true) {
        main.SetWizData(&data);
        main.m_batchMode = batch;
        return main;
    }

    std::vector<std::string> Messages() const {
        std::vector<std::string> out;
        for (const auto& m : main.GetMessages())
            out.push_back(m.text.str());
        return out;
    }

    std::vector<std::string> ActiveBlocks() const {
        std::vector<std::string> out;
        for (const auto& b : data.GetBlocks())
            if (b->IsUsed())
                out.push_back(b->GetName().str());
        return out;
    }
};

inline const char* const kDataError = "Tessel Wizard internal data error";
