#include "settings/OptionPages.h"

#include "core/Numbers.h"
#include "core/Strings.h"
#include "settings/ListingObject.h"
#include "settings/OptionTexts.h"
#include "settings/ParamStore.h"

#include <algorithm>

namespace pyr {

namespace {

std::string ValueText(const OptionValue& value) {
    switch (value.entry->type) {
    case OptionType::Switch:
    case OptionType::Integer:
        return Sprintf("%d", value.integer);
    case OptionType::Real:
        return Sprintf("%f", value.real);
    case OptionType::Text:
        return value.text;
    }
    return {};
}

} // namespace

std::string CheckOptionNumber(std::string_view section, std::string_view key, std::string_view text,
                              OptionType type, double minimum, double maximum, double& value) {
    const std::string typed(Trimmed(text));
    const std::string sectionText(section), keyText(key);
    if (type == OptionType::Switch) {
        if (typed != "0" && typed != "1")
            return Sprintf(kMsgNotASwitch, sectionText.c_str(), keyText.c_str(), typed.c_str());
        value = typed == "1";
        return {};
    }
    if (type == OptionType::Integer) {
        long long integer = 0;
        if (!ParseInt(typed, integer)) {
            double real = 0;
            return Sprintf(ParseDouble(typed, real) ? kMsgNotAnInteger : kMsgNotANumber, sectionText.c_str(),
                           keyText.c_str(), typed.c_str());
        }
        value = static_cast<double>(integer);
    } else if (!ParseDouble(typed, value)) {
        return Sprintf(kMsgNotANumber, sectionText.c_str(), keyText.c_str(), typed.c_str());
    }
    if (!(value >= minimum && value <= maximum)) // not-a-number is outside too
        return Sprintf(kMsgOutOfLimits, sectionText.c_str(), keyText.c_str(), typed.c_str(),
                       FormatShortest(minimum).c_str(), FormatShortest(maximum).c_str());
    return {};
}

// --- A page of the table ------------------------------------------------------------------------------

COptionPage::COptionPage(std::string_view section) : m_section(section) {
    AddSection(section);
}

void COptionPage::AddSection(std::string_view section) {
    if (section != m_section) m_otherSections.push_back(section);
    for (const auto& entry : CalcOptionTable()) {
        if (entry.section != section) continue;
        OptionValue value;
        value.entry = &entry;
        value.integer = LenientAtoi(entry.defaultValue);
        value.real = LenientAtof(entry.defaultValue);
        value.text = entry.defaultValue;
        m_values.push_back(std::move(value));
    }
}

void COptionPage::Read(std::string_view paramPath) {
    for (auto& value : m_values) {
        const OptionEntry& entry = *value.entry;
        switch (entry.type) {
        case OptionType::Switch:
        case OptionType::Integer:
            value.integer = ReadOptionInt(paramPath, entry.section, entry.key);
            break;
        case OptionType::Real:
            value.real = ReadOptionReal(paramPath, entry.section, entry.key);
            break;
        case OptionType::Text:
            value.text = ReadOptionText(paramPath, entry.section, entry.key);
            break;
        }
    }
}

bool COptionPage::Write(std::string_view paramPath) const {
    bool written = true;
    for (const auto& value : m_values)
        written = WriteKey(paramPath, value.entry->key) && written;
    return written;
}

bool COptionPage::WriteKey(std::string_view paramPath, std::string_view key) const {
    const OptionValue* value = Find(key);
    if (!value) return false;
    const OptionEntry& entry = *value->entry;
    switch (entry.type) {
    case OptionType::Switch:
        return WriteParamBool(paramPath, entry.section, entry.key,
                              static_cast<unsigned char>(value->integer));
    case OptionType::Integer:
        return WriteParamInt(paramPath, entry.section, entry.key, value->integer);
    case OptionType::Real:
        return WriteParamDouble(paramPath, entry.section, entry.key, value->real);
    case OptionType::Text:
        return WriteParamString(paramPath, entry.section, entry.key, value->text);
    }
    return false;
}

bool COptionPage::Holds(std::string_view section) const {
    return EqualIgnoringCase(m_section, section) ||
           std::any_of(m_otherSections.begin(), m_otherSections.end(),
                       [section](std::string_view other) { return EqualIgnoringCase(other, section); });
}

std::string_view COptionPage::SectionOf(std::string_view key) const {
    const OptionValue* value = Find(key);
    return value ? value->entry->section : m_section;
}

// A section under its heading, an empty line between two sections, as the file shows them.
std::vector<std::string> COptionPage::Lines() const {
    std::vector<std::string> lines{"[" + std::string(m_section) + "]"};
    std::string_view section = m_section;
    for (const auto& value : m_values) {
        if (value.entry->section != section) {
            section = value.entry->section;
            lines.emplace_back();
            lines.push_back("[" + std::string(section) + "]");
        }
        lines.push_back(std::string(value.entry->key) + "=" + ValueText(value));
    }
    return lines;
}

std::string COptionPage::Set(std::string_view key, std::string_view text) {
    OptionValue* value = Find(key);
    if (!value) return Sprintf(kMsgUnknownKey, std::string(m_section).c_str(), std::string(key).c_str());
    const OptionEntry& entry = *value->entry;
    if (entry.type == OptionType::Text) {
        value->text = text;
        return {};
    }
    double number = 0;
    std::string refusal =
        CheckOptionNumber(entry.section, entry.key, text, entry.type, entry.minimum, entry.maximum, number);
    if (!refusal.empty()) return refusal;
    if (entry.type == OptionType::Real)
        value->real = number;
    else
        value->integer = static_cast<int>(number);
    return {};
}

std::pair<std::string, std::string> COptionPage::KeyAndValue(std::string_view key) const {
    const OptionValue* value = Find(key);
    if (!value) return {std::string(key), {}};
    return {std::string(value->entry->key), ValueText(*value)};
}

int COptionPage::Int(std::string_view key) const {
    const OptionValue* value = Find(key);
    return value ? value->integer : 0;
}

double COptionPage::Real(std::string_view key) const {
    const OptionValue* value = Find(key);
    return value ? value->real : 0;
}

const std::string& COptionPage::Text(std::string_view key) const {
    static const std::string kNone;
    const OptionValue* value = Find(key);
    return value ? value->text : kNone;
}

void COptionPage::SetInt(std::string_view key, int value) {
    if (OptionValue* held = Find(key))
        held->integer =
            std::clamp(value, static_cast<int>(held->entry->minimum), static_cast<int>(held->entry->maximum));
}

void COptionPage::SetReal(std::string_view key, double value) {
    if (OptionValue* held = Find(key))
        held->real =
            value >= held->entry->minimum ? std::min(value, held->entry->maximum) : held->entry->minimum;
}

void COptionPage::SetText(std::string_view key, std::string value) {
    if (OptionValue* held = Find(key)) held->text = std::move(value);
}

const OptionValue* COptionPage::Find(std::string_view key) const {
    for (const auto& value : m_values)
        if (EqualIgnoringCase(value.entry->key, key)) return &value;
    return nullptr;
}

OptionValue* COptionPage::Find(std::string_view key) {
    return const_cast<OptionValue*>(std::as_const(*this).Find(key));
}

// --- Listings -------------------------------------------------------------------------------------------

CPagOptionListing::CPagOptionListing() : COptionPage(kSectionListings) {
    AddSection(kSectionListingLayout);
}

void CPagOptionListing::AddRadiatedColumn(std::string_view column) {
    SetText("RayonContenu", Text("RayonContenu") + "," + std::string(column));
}

} // namespace pyr
