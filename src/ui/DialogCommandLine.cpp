// Driving a dialog from the words of a command line. CLI11 splits the words into options and values;
// what it would say in English never reaches the person: every fault is put into French here, and
// the few that CLI11 would accept silently (a switch given a value, an option taking the next option
// as its value) are refused before it runs.
#include "ui/DialogCommandLine.h"

#include "core/TextEncoding.h"

#include <CLI/CLI.hpp>
#include <algorithm>
#include <cctype>
#include <map>
#include <optional>

namespace pyr::ui {

namespace {

// The words of this mechanism, in one place.
constexpr std::string_view kProgram = "pyralis";
constexpr std::string_view kGeoBaseName = "geobase";
constexpr std::string_view kGeoBaseValue = "FICHIER";
constexpr std::string_view kGeoBaseHelp = "la GéoBase à traiter, au lieu de la dernière utilisée";
constexpr std::string_view kHelpHelp = "affiche cette aide";
constexpr std::string_view kRepeatable = " (répétable)";
constexpr std::string_view kHostOptions = "--params CHEMIN, --oui, --non : voir pyralis --help";
constexpr std::string_view kUnknownOption = "Option inconnue : ";
constexpr std::string_view kUnexpectedArgument = "Argument inattendu : ";
constexpr std::string_view kMissingValue = "Valeur manquante pour ";
constexpr std::string_view kNoValueTaken = "L'option ne prend pas de valeur : ";
constexpr std::string_view kGivenTwice = "Option donnée plusieurs fois : ";
constexpr std::string_view kBadLine = "Ligne de commande incorrecte";
constexpr std::string_view kBadDeclaration = "Option de dialogue mal déclarée : ";

using Option = DialogOptions::Option;

bool IsSwitch(const Option& option) {
    return option.valueName.empty();
}

// The options of a dialog: the common ones first, then its own.
DialogOptions AllOptions(DialogModel& dialog) {
    DialogOptions options;
    options.Value(std::string(kGeoBaseName), std::string(kGeoBaseValue), std::string(kGeoBaseHelp),
                  [&dialog](const std::string& path) {
                      dialog.SetGeoBase(path);
                      return std::string();
                  });
    dialog.DeclareOptions(options);
    return options;
}

const Option* Find(const DialogOptions& options, std::string_view name) {
    for (const auto& option : options.Options())
        if (option.name == name) return &option;
    return nullptr;
}

CommandLineOutcome Usage(std::string_view command, std::string_view reason, std::string_view word) {
    std::string text(reason);
    text += word;
    text += "\nVoir : ";
    text += kProgram;
    text += ' ';
    text += command;
    text += " --help";
    return {CommandLineOutcome::Kind::Usage, std::move(text)};
}

bool IsHelpWord(const std::string& word) {
    return word == "--help" || word == "-h";
}

// What a person means as an option rather than a value: "--x" or "-x". A negative number ("-12.5")
// is a value.
bool LooksLikeOption(const std::string& word) {
    return word.size() >= 2 && word[0] == '-' &&
           (word[1] == '-' || std::isalpha(static_cast<unsigned char>(word[1])));
}

// The faults of values: a value option last or followed by another option, "--x=" with nothing after
// it, a switch given a value. Unknown options and stray words are left to the parse.
std::optional<CommandLineOutcome> CheckValues(const DialogOptions& options, std::string_view command,
                                              const std::vector<std::string>& words) {
    for (std::size_t i = 0; i < words.size(); ++i) {
        const std::string& word = words[i];
        if (word == "--") break; // what follows is only words
        if (word.size() < 3 || word.compare(0, 2, "--") != 0) continue;
        std::size_t equal = word.find('=');
        std::string name = word.substr(2, equal == std::string::npos ? std::string::npos : equal - 2);
        const Option* option = Find(options, name);
        if (!option) continue;
        if (IsSwitch(*option)) {
            if (equal != std::string::npos) return Usage(command, kNoValueTaken, "--" + name);
        } else if (equal != std::string::npos) {
            if (equal + 1 == word.size()) return Usage(command, kMissingValue, "--" + name);
        } else if (option->optional) {
            if (i + 1 < words.size() && words[i + 1] != "--" && !LooksLikeOption(words[i + 1])) ++i;
        } else if (i + 1 == words.size() || LooksLikeOption(words[i + 1])) {
            return Usage(command, kMissingValue, "--" + name);
        } else {
            ++i; // its value
        }
    }
    return std::nullopt;
}

} // namespace

CommandLineOutcome ApplyCommandLine(DialogModel& dialog, std::string_view command,
                                    const std::vector<std::string>& arguments) {
    if (std::any_of(arguments.begin(), std::find(arguments.begin(), arguments.end(), "--"), IsHelpWord))
        return {CommandLineOutcome::Kind::Help, DialogHelp(dialog, command)};

    const DialogOptions options = AllOptions(dialog);
    if (auto fault = CheckValues(options, command, arguments)) return *fault;

    CLI::App app;
    app.allow_extras(); // unknown words are kept, to be named in French
    std::map<const CLI::Option*, const Option*> declared;
    for (const auto& option : options.Options()) {
        try {
            CLI::Option* parsed = IsSwitch(option)
                                      ? app.add_flag("--" + option.name)
                                      : app.add_option("--" + option.name)
                                            ->expected(option.optional ? 0 : 1, 1)
                                            ->allow_extra_args(false)
                                            ->multi_option_policy(CLI::MultiOptionPolicy::TakeAll);
            declared[parsed] = &option;
        } catch (const CLI::ConstructionError&) {
            return {CommandLineOutcome::Kind::Refused, std::string(kBadDeclaration) + "--" + option.name};
        }
    }

    // CLI11 takes the words last first.
    std::vector<std::string> reversed(arguments.rbegin(), arguments.rend());
    try {
        app.parse(reversed);
    } catch (const CLI::CallForHelp&) {
        return {CommandLineOutcome::Kind::Help, DialogHelp(dialog, command)};
    } catch (const CLI::ParseError&) {
        return Usage(command, kBadLine, "");
    }

    // The extras keep the "--" that ends the options; what follows it is only words, whatever their
    // first character.
    std::vector<std::string> extras = app.remaining();
    if (!extras.empty()) {
        const bool words = extras.front() == "--";
        if (words) extras.erase(extras.begin());
        if (!extras.empty()) {
            const std::string& word = extras.front();
            if (!words && word.size() > 1 && word[0] == '-')
                return Usage(command, kUnknownOption, word.substr(0, word.find('=')));
            return Usage(command, kUnexpectedArgument, word);
        }
    }

    // Each occurrence in the order given, with its value: the n-th occurrence of a value option holds
    // its n-th result.
    std::vector<std::pair<const Option*, std::string>> given;
    std::map<const CLI::Option*, std::size_t> seen;
    for (const CLI::Option* parsed : app.parse_order()) {
        auto found = declared.find(parsed);
        if (found == declared.end()) continue;
        const Option& option = *found->second;
        std::size_t occurrence = seen[parsed]++;
        if (occurrence > 0 && !option.repeatable) return Usage(command, kGivenTwice, "--" + option.name);
        given.emplace_back(&option, IsSwitch(option) ? std::string() : parsed->results().at(occurrence));
    }

    for (const auto& [option, value] : given) {
        if (!option->apply) continue;
        std::string refusal = option->apply(value);
        if (!refusal.empty()) return {CommandLineOutcome::Kind::Refused, std::move(refusal)};
    }
    return {};
}

std::string DialogHelp(DialogModel& dialog, std::string_view command) {
    const DialogOptions options = AllOptions(dialog);

    std::vector<std::pair<std::string, std::string>> entries;
    for (const auto& option : options.Options()) {
        std::string left = "--" + option.name;
        if (option.optional)
            left += " [" + option.valueName + ']';
        else if (!IsSwitch(option))
            left += ' ' + option.valueName;
        entries.emplace_back(std::move(left),
                             option.repeatable ? option.help + std::string(kRepeatable) : option.help);
    }
    entries.emplace_back("-h, --help", std::string(kHelpHelp));

    std::size_t column = 0;
    for (const auto& entry : entries)
        column = std::max(column, Utf8Length(entry.first));

    std::string text = "Usage : ";
    text += kProgram;
    text += ' ';
    text += command;
    text += " [options]\n";
    if (!dialog.Inputs().title.empty()) text += dialog.Inputs().title + '\n';
    text += "\nOptions :\n";
    for (const auto& [left, help] : entries) {
        text += "  " + left;
        text.append(column - Utf8Length(left) + 3, ' ');
        text += help + '\n';
    }
    text += "  ";
    text += kHostOptions;
    return text;
}

} // namespace pyr::ui
