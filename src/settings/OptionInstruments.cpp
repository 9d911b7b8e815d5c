#include "settings/OptionInstruments.h"

#include "core/Strings.h"
#include "settings/CalcOptions.h"
#include "settings/ParamStore.h"

#include <algorithm>
#include <array>
#include <cctype>

namespace pyr {

namespace {

constexpr std::array<InstrumentValueKey, 6> kValueKeys = {{
    {"ConstPrisme", -1, 1, &InstrumentOptions::prismConstant},
    {"CollVerticale", -400, 400, &InstrumentOptions::verticalCollimation},
    {"SigmaAh", 0, 400, &InstrumentOptions::sigmaAh},
    {"SigmaAv", 0, 400, &InstrumentOptions::sigmaAv},
    {"SigmaDi", 0, 1, &InstrumentOptions::sigmaDi},
    {"SigmaPpm", -1000, 1000, &InstrumentOptions::sigmaPpm},
}};

// A guard against a file that numbers instruments without end.
constexpr int kMaxInstruments = 10000;

std::string Numbered(const char* prefix, int number) {
    return Sprintf("%s%d", prefix, number);
}

std::string ReadName(std::string_view paramPath, int number) {
    std::string name;
    ReadParamString(paramPath, kSectionInstruments, Numbered(kInstrumentNameKey, number), "", name);
    return name;
}

} // namespace

std::span<const InstrumentValueKey> InstrumentValueKeys() {
    return kValueKeys;
}

bool SplitInstrumentKey(std::string_view key, std::string& prefix, int& number) {
    std::size_t digits = key.size();
    while (digits > 0 && std::isdigit(static_cast<unsigned char>(key[digits - 1])))
        --digits;
    if (digits == 0 || digits == key.size() || key.size() - digits > 6) return false;
    prefix = key.substr(0, digits);
    number = 0;
    for (char c : key.substr(digits))
        number = number * 10 + (c - '0');
    return true;
}

std::vector<InstrumentOptions> ReadInstruments(std::string_view paramPath) {
    std::vector<InstrumentOptions> instruments;
    for (int number = 0; number < kMaxInstruments; ++number) {
        InstrumentOptions instrument;
        instrument.name = ReadName(paramPath, number);
        if (instrument.name.empty()) {
            if (number == 0) continue; // a list numbered from 1, as a person may write it by hand
            break;
        }
        for (const auto& key : kValueKeys)
            ReadParamDouble(paramPath, kSectionInstruments, Numbered(key.prefix, number), 0, key.minimum,
                            key.maximum, instrument.*key.member);
        instruments.push_back(std::move(instrument));
    }
    auto standard = std::find_if(instruments.begin(), instruments.end(),
                                 [](const InstrumentOptions& i) { return i.name == kStandardInstrument; });
    if (standard == instruments.end())
        instruments.insert(instruments.begin(), InstrumentOptions{kStandardInstrument});
    else
        std::rotate(instruments.begin(), standard, standard + 1);
    return instruments;
}

bool WriteInstrument(std::string_view paramPath, int number, const InstrumentOptions& instrument) {
    bool written = WriteParamString(paramPath, kSectionInstruments, Numbered(kInstrumentNameKey, number),
                                    instrument.name);
    for (const auto& key : kValueKeys)
        written = WriteParamDouble(paramPath, kSectionInstruments, Numbered(key.prefix, number),
                                   instrument.*key.member) &&
                  written;
    return written;
}

bool WriteInstruments(std::string_view paramPath, const std::vector<InstrumentOptions>& instruments) {
    bool written = true;
    for (std::size_t i = 0; i < instruments.size(); ++i)
        written = WriteInstrument(paramPath, static_cast<int>(i), instruments[i]) && written;
    return EndInstrumentList(paramPath, static_cast<int>(instruments.size())) && written;
}

bool EndInstrumentList(std::string_view paramPath, int number) {
    if (ReadName(paramPath, number).empty()) return true;
    return WriteParamString(paramPath, kSectionInstruments, Numbered(kInstrumentNameKey, number), "");
}

} // namespace pyr
