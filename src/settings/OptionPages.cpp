#include "settings/OptionPages.h"

#include "core/Numbers.h"
#include "core/Strings.h"
#include "settings/OptionTexts.h"
#include "settings/ParamStore.h"

#include <algorithm>

namespace pyr {

namespace {

std::string ValueText(const OptionValue& value) {
    switch (value.spec->type) {
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

// A number typed for a key, checked against its kind and its limits: empty when accepted.
std::string CheckNumber(std::string_view section, std::string_view key, std::string_view text,
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

} // namespace

// --- A page of the table ------------------------------------------------------------------------------

COptionPage::COptionPage(std::string_view section) : m_section(section) {
    for (const auto& spec : CalcOptionSpecs()) {
        if (spec.section != section) continue;
        OptionValue value;
        value.spec = &spec;
        value.integer = LenientAtoi(spec.defaultValue);
        value.real = LenientAtof(spec.defaultValue);
        value.text = spec.defaultValue;
        m_values.push_back(std::move(value));
    }
}

void COptionPage::Read(std::string_view paramPath) {
    for (auto& value : m_values) {
        const OptionSpec& spec = *value.spec;
        switch (spec.type) {
        case OptionType::Switch:
        case OptionType::Integer:
            value.integer = ReadOptionInt(paramPath, spec.section, spec.key);
            break;
        case OptionType::Real:
            value.real = ReadOptionReal(paramPath, spec.section, spec.key);
            break;
        case OptionType::Text:
            value.text = ReadOptionText(paramPath, spec.section, spec.key);
            break;
        }
    }
}

bool COptionPage::Write(std::string_view paramPath) const {
    bool written = true;
    for (const auto& value : m_values)
        written = WriteKey(paramPath, value.spec->key) && written;
    return written;
}

bool COptionPage::WriteKey(std::string_view paramPath, std::string_view key) const {
    const OptionValue* value = Find(key);
    if (!value) return false;
    const OptionSpec& spec = *value->spec;
    switch (spec.type) {
    case OptionType::Switch:
        return WriteParamBool(paramPath, spec.section, spec.key, static_cast<unsigned char>(value->integer));
    case OptionType::Integer:
        return WriteParamInt(paramPath, spec.section, spec.key, value->integer);
    case OptionType::Real:
        return WriteParamDouble(paramPath, spec.section, spec.key, value->real);
    case OptionType::Text:
        return WriteParamString(paramPath, spec.section, spec.key, value->text);
    }
    return false;
}

std::vector<std::string> COptionPage::Lines() const {
    std::vector<std::string> lines{"[" + std::string(m_section) + "]"};
    for (const auto& value : m_values)
        lines.push_back(std::string(value.spec->key) + "=" + ValueText(value));
    return lines;
}

std::string COptionPage::Set(std::string_view key, std::string_view text) {
    OptionValue* value = Find(key);
    if (!value) return Sprintf(kMsgUnknownKey, std::string(m_section).c_str(), std::string(key).c_str());
    const OptionSpec& spec = *value->spec;
    if (spec.type == OptionType::Text) {
        value->text = text;
        return {};
    }
    double number = 0;
    std::string refusal =
        CheckNumber(spec.section, spec.key, text, spec.type, spec.minimum, spec.maximum, number);
    if (!refusal.empty()) return refusal;
    if (spec.type == OptionType::Real)
        value->real = number;
    else
        value->integer = static_cast<int>(number);
    return {};
}

std::pair<std::string, std::string> COptionPage::KeyAndValue(std::string_view key) const {
    const OptionValue* value = Find(key);
    if (!value) return {std::string(key), {}};
    return {std::string(value->spec->key), ValueText(*value)};
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
            std::clamp(value, static_cast<int>(held->spec->minimum), static_cast<int>(held->spec->maximum));
}

void COptionPage::SetReal(std::string_view key, double value) {
    if (OptionValue* held = Find(key))
        held->real =
            value >= held->spec->minimum ? std::min(value, held->spec->maximum) : held->spec->minimum;
}

void COptionPage::SetText(std::string_view key, std::string value) {
    if (OptionValue* held = Find(key)) held->text = std::move(value);
}

const OptionValue* COptionPage::Find(std::string_view key) const {
    for (const auto& value : m_values)
        if (EqualIgnoringCase(value.spec->key, key)) return &value;
    return nullptr;
}

OptionValue* COptionPage::Find(std::string_view key) {
    return const_cast<OptionValue*>(std::as_const(*this).Find(key));
}

// --- Listings -------------------------------------------------------------------------------------------

void CPagOptionListing::AddRadiatedColumn(std::string_view column) {
    SetText("RayonContenu", Text("RayonContenu") + "," + std::string(column));
}

// --- Instruments ----------------------------------------------------------------------------------------

namespace {

const InstrumentValueKey* FindValueKey(std::string_view prefix) {
    for (const auto& key : InstrumentValueKeys())
        if (EqualIgnoringCase(key.prefix, prefix)) return &key;
    return nullptr;
}

} // namespace

void CPagOptionAppareil::Read(std::string_view paramPath) {
    m_instruments = ReadInstruments(paramPath);
}

bool CPagOptionAppareil::Write(std::string_view paramPath) const {
    return WriteInstruments(paramPath, m_instruments);
}

std::vector<std::string> CPagOptionAppareil::Lines() const {
    std::vector<std::string> lines{"[" + std::string(kSectionInstruments) + "]"};
    for (std::size_t i = 0; i < m_instruments.size(); ++i) {
        const InstrumentOptions& instrument = m_instruments[i];
        lines.push_back(Sprintf("%s%zu=%s", kInstrumentNameKey, i, instrument.name.c_str()));
        for (const auto& key : InstrumentValueKeys())
            lines.push_back(Sprintf("%s%zu=%f", key.prefix, i, instrument.*key.member));
    }
    return lines;
}

std::string CPagOptionAppareil::Set(std::string_view key, std::string_view text) {
    const std::string section(kSectionInstruments), keyText(key);
    std::string prefix;
    int number = 0;
    const InstrumentValueKey* valueKey = nullptr;
    const bool isName =
        SplitInstrumentKey(key, prefix, number) && EqualIgnoringCase(prefix, kInstrumentNameKey);
    if (!isName && (prefix.empty() || !(valueKey = FindValueKey(prefix))))
        return Sprintf(kMsgUnknownKey, section.c_str(), keyText.c_str());

    const int count = static_cast<int>(m_instruments.size());
    if (isName) {
        const std::string name(Trimmed(text));
        if (number > count) return Sprintf(kMsgNextInstrumentNumber, section.c_str(), keyText.c_str(), count);
        if (name.empty()) return Sprintf(kMsgEmptyInstrumentName, section.c_str(), keyText.c_str());
        if (number == 0 && name != kStandardInstrument)
            return Sprintf(kMsgStandardInstrument, section.c_str(), keyText.c_str(), kStandardInstrument);
        if (number == count)
            AddInstrument(name);
        else
            m_instruments[static_cast<std::size_t>(number)].name = name;
        return {};
    }
    if (number >= count) {
        if (number == count) return Sprintf(kMsgNewInstrumentName, section.c_str(), keyText.c_str(), number);
        return Sprintf(kMsgNoInstrument, section.c_str(), keyText.c_str(), number, count - 1);
    }
    double value = 0;
    std::string refusal =
        CheckNumber(section, keyText, text, OptionType::Real, valueKey->minimum, valueKey->maximum, value);
    if (refusal.empty()) m_instruments[static_cast<std::size_t>(number)].*valueKey->member = value;
    return refusal;
}

bool CPagOptionAppareil::WriteKey(std::string_view paramPath, std::string_view key) const {
    std::string prefix;
    int number = 0;
    if (!SplitInstrumentKey(key, prefix, number) || number >= static_cast<int>(m_instruments.size()))
        return false;
    const InstrumentOptions& instrument = m_instruments[static_cast<std::size_t>(number)];
    if (EqualIgnoringCase(prefix, kInstrumentNameKey)) {
        const bool written = WriteInstrument(paramPath, number, instrument);
        return (number + 1 < static_cast<int>(m_instruments.size()) ||
                EndInstrumentList(paramPath, number + 1)) &&
               written;
    }
    const InstrumentValueKey* valueKey = FindValueKey(prefix);
    return valueKey &&
           WriteParamDouble(paramPath, kSectionInstruments, Sprintf("%s%d", valueKey->prefix, number),
                            instrument.*valueKey->member);
}

std::pair<std::string, std::string> CPagOptionAppareil::KeyAndValue(std::string_view key) const {
    std::string prefix;
    int number = 0;
    if (!SplitInstrumentKey(key, prefix, number) || number >= static_cast<int>(m_instruments.size()))
        return {std::string(key), {}};
    const InstrumentOptions& instrument = m_instruments[static_cast<std::size_t>(number)];
    if (EqualIgnoringCase(prefix, kInstrumentNameKey))
        return {Sprintf("%s%d", kInstrumentNameKey, number), instrument.name};
    const InstrumentValueKey* valueKey = FindValueKey(prefix);
    if (!valueKey) return {std::string(key), {}};
    return {Sprintf("%s%d", valueKey->prefix, number), Sprintf("%f", instrument.*valueKey->member)};
}

int CPagOptionAppareil::AddInstrument(std::string name) {
    if (Trimmed(name).empty()) return -1;
    m_instruments.push_back(InstrumentOptions{std::move(name)});
    return static_cast<int>(m_instruments.size()) - 1;
}

bool CPagOptionAppareil::RemoveInstrument(int number) {
    if (number <= 0 || number >= static_cast<int>(m_instruments.size())) return false;
    m_instruments.erase(m_instruments.begin() + number);
    return true;
}

void CPagOptionAppareil::SetInstrument(int number, InstrumentOptions values) {
    if (number < 0 || number >= static_cast<int>(m_instruments.size())) return;
    InstrumentOptions& instrument = m_instruments[static_cast<std::size_t>(number)];
    if (number == 0 || Trimmed(values.name).empty()) values.name = instrument.name;
    for (const auto& key : InstrumentValueKeys()) {
        double& value = values.*key.member;
        value = value >= key.minimum ? std::min(value, key.maximum) : key.minimum;
    }
    instrument = std::move(values);
}

} // namespace pyr
