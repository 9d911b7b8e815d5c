#include "HostOptions.h"

HostOptions ParseHostOptions(const std::vector<std::string>& words) {
    HostOptions options;
    for (size_t i = 0; i < words.size(); ++i) {
        const std::string& word = words[i];
        if (word == "--params" || word.rfind("--params=", 0) == 0) {
            if (word.size() > 8) {
                options.params = word.substr(9);
            } else if (i + 1 < words.size()) {
                options.params = words[++i];
            } else {
                options.error = "Valeur manquante pour --params";
                return options;
            }
        } else if (word == "--oui" || word == "--non") {
            options.answer = word == "--oui";
        } else if (word == "--interactif") {
            options.interactive = true;
        } else if (!options.command.empty()) {
            options.commandWords.push_back(word);
        } else if (word == "--help" || word == "-h") {
            options.help = true;
        } else if (!word.empty() && word[0] == '-') {
            options.error = "Option inconnue avant le nom de la commande : " + word;
            return options;
        } else {
            options.command = word;
        }
    }
    return options;
}

std::vector<std::string> SplitCommandLine(const std::string& line) {
    std::vector<std::string> words;
    std::string word;
    bool inWord = false, quoted = false;
    for (char c : line) {
        if (c == '"') {
            quoted = !quoted;
            inWord = true;
        } else if (!quoted && (c == ' ' || c == '\t' || c == '\r' || c == '\n')) {
            if (inWord) words.push_back(word);
            word.clear();
            inWord = false;
        } else {
            word += c;
            inWord = true;
        }
    }
    if (inWord) words.push_back(word);
    return words;
}
