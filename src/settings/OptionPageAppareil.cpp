#include "core/Strings.h"
#include "settings/OptionPages.h"
#include "settings/OptionTexts.h"
#include "settings/ParamStore.h"

#include <algorithm>

namespace pyr {

// The instruments page: a list numbered from 0, the standard instrument first (OptionInstruments.h).

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
    std::string refusal = CheckOptionNumber(section, keyText, text, OptionType::Real, valueKey->minimum,
                                            valueKey->maximum, value);
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
