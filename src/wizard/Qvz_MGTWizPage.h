#pragma once
// Common base of the six setup pages, with the conversions they share.

#include "Qvz_WizPage.h"

class Qvz_MGTWizPage : public Qvz_WizPage {
public:
    explicit Qvz_MGTWizPage(Qvz_WizMain* main);
    ~Qvz_MGTWizPage() override;

    bool DoBatchPage() override { return true; }
    bool CreateGuiDlg(QWidget* parent) override = 0;
    Wg_WizardPage* GetGuiDlg() override = 0;

    // Digits as a sized literal: radix 0 binary ("%d'b%s"), else hexadecimal
    // ("%d'h%s" with four bits a digit).
    static Port::StringBase GetSizedLiteral(const Port::StringBase& digits, int radix);
    // The text after "'h" (radix 1) or "'b" (any other radix); value
    // unchanged when it holds no such marker.
    static Port::StringBase StripSizedLiteral(const Port::StringBase& value, int radix);
    // True when mask holds no more '0' characters than seqLength says.
    static bool ValidateSeqMask(const Port::StringBase& mask, const Port::StringBase& seqLength);
    // Which encodings the block's PMA speed allows; true when the PMA speed is
    // its attribute's default.
    static bool GetGT10EncodingChoices(Qvz_Block* block, bool& allowNone, bool& allow8B10B,
                                       bool& allow64B66B);

    // What the pages say when they have no design data to work on.
    static constexpr const char* kDataError = "Tessel Wizard internal data error.";
    static const char* BoolText(bool b) { return b ? "TRUE" : "FALSE"; }
    // Flags read as true only for "TRUE"; a missing attribute reads as false.
    static bool IsTrue(const Port::StringBase& value);
    static bool IsTrue(const Qvz_Block* block, const char* name);
    // Writes value only when the block has the attribute.
    static void SetIfPresent(Qvz_Block* block, const char* name, const Port::StringBase& value);

    // True when s is not empty and holds decimal digits only.
    static bool IsAllDigits(const Port::StringBase& s);
    // The text from byte pos on, beginning at a whole character: a cut inside
    // a multi-byte UTF-8 character would leave a stray byte that no
    // design-data file can hold. Empty when pos is past the end.
    static Port::StringBase TextFrom(const Port::StringBase& value, std::size_t pos);
    // The digits of a binary attribute value: a sized literal "N'b..." keeps
    // its last N digits; anything else is returned as it is. Empty for null.
    static Port::StringBase GetBinaryValue(const Qvz_Attribute* attr);
    // Writes digits, as a sized binary literal when sized (GT11) and bare
    // otherwise; a null attribute is left alone.
    static void SetBinaryValue(Qvz_Attribute* attr, const Port::StringBase& digits, bool sized);

protected:
    // Shared step of every page's CreateGuiDlg once the controller exists (or not).
    bool FinishGuiCreation(bool created);
};
