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
DialogOptions AllOptions(Dialog& dialog) {
    DialogOptions options;
    const std::string help = dialog.GeoBaseHelp();
    options.Value(std::string(kGeoBaseName), std::string(kGeoBaseValue),
                  help.empty() ? std::string(kGeoBaseHelp) : help, [&dialog](const std::string& path) {
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

// Steps over the `count` values that follow words[i]; false when the words end first or an option
// stands in their place.
bool TakeValues(const std::vector<std::string>& words, std::size_t& i, int count) {
    for (int n = 0; n < count; ++n) {
        if (i + 1 == words.size() || LooksLikeOption(words[i + 1])) return false;
        ++i;
    }
    return true;
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
            // "--x=v" gives the first value; the others follow.
            if (equal + 1 == word.size() || !TakeValues(words, i, option->count - 1))
                return Usage(command, kMissingValue, "--" + name);
        } else if (option->optional) {
            if (i + 1 < words.size() && words[i + 1] != "--" && !LooksLikeOption(words[i + 1])) ++i;
        } else if (!TakeValues(words, i, option->count)) {
            return Usage(command, kMissingValue, "--" + name);
        }
    }
    return std::nullopt;
}

} // namespace

CommandLineOutcome ApplyCommandLine(Dialog& dialog, std::string_view command,
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
                                            ->expected(option.optional ? 0 : option.count, option.count)
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

    // The extras are the positional words, in their order; they keep the "--" that ends the options,
    // and what follows it is only words, whatever their first character.
    std::vector<std::string> positionals;
    bool words = false;
    for (const std::string& word : app.remaining()) {
        if (!words && word == "--") {
            words = true;
            continue;
        }
        if (!words && word.size() > 1 && word[0] == '-')
            return Usage(command, kUnknownOption, word.substr(0, word.find('=')));
        if (positionals.size() == options.Positionals().size())
            return Usage(command, kUnexpectedArgument, word);
        positionals.push_back(word);
    }

    // Each occurrence in the order given, with its values. The parse names an option once for each value
    // it took: the n-th occurrence of an option of k values holds the results n*k to n*k + k - 1.
    std::vector<std::pair<const Option*, std::vector<std::string>>> given;
    std::map<const CLI::Option*, std::size_t> seen;
    for (const CLI::Option* parsed : app.parse_order()) {
        auto found = declared.find(parsed);
        if (found == declared.end()) continue;
        const Option& option = *found->second;
        const std::size_t count = static_cast<std::size_t>(option.count);
        const std::size_t entry = seen[parsed]++;
        if (entry % count != 0) continue; // a further value of the same occurrence
        const std::size_t occurrence = entry / count;
        if (occurrence > 0 && !option.repeatable) return Usage(command, kGivenTwice, "--" + option.name);
        std::vector<std::string> values;
        if (IsSwitch(option)) {
            values.emplace_back();
        } else {
            for (std::size_t k = 0; k < count; ++k)
                values.push_back(parsed->results().at(occurrence * count + k));
        }
        given.emplace_back(&option, std::move(values));
    }

    // The positional words first: they name what the command works on; the options then say how.
    for (std::size_t i = 0; i < positionals.size(); ++i) {
        const auto& apply = options.Positionals()[i].apply;
        std::string refusal = apply ? apply(positionals[i]) : std::string();
        if (!refusal.empty()) return {CommandLineOutcome::Kind::Refused, std::move(refusal)};
    }
    for (const auto& [option, values] : given) {
        std::string refusal;
        if (option->applyValues)
            refusal = option->applyValues(values);
        else if (option->apply)
            refusal = option->apply(values.front());
        if (!refusal.empty()) return {CommandLineOutcome::Kind::Refused, std::move(refusal)};
    }
    return {};
}

std::string DialogHelp(Dialog& dialog, std::string_view command) {
    const DialogOptions options = AllOptions(dialog);

    std::vector<std::pair<std::string, std::string>> entries;
    for (const auto& positional : options.Positionals())
        entries.emplace_back(positional.valueName, positional.help);
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
    for (const auto& positional : options.Positionals())
        text += " [" + positional.valueName + ']';
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
