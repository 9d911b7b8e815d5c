// The answers a person gives the console at a question: typed, or given by a key (Enter, Ctrl-D, Escape),
// through a line editor or from the input stream.
#include "TestSupport.h"
#include "ui/ConsoleFrontEnd.h"

#include <deque>
#include <gtest/gtest.h>

using namespace pyr;
using ui::Answer;
using ui::Buttons;
using ui::LinePurpose;
using ui::TypedLine;

namespace {

TypedLine Typed(std::string text) {
    return {TypedLine::Kind::Line, std::move(text)};
}
const TypedLine kCtrlD{TypedLine::Kind::End, ""};
const TypedLine kEscape{TypedLine::Kind::Cancel, ""};

// A line editor that gives lines prepared in advance and notes what it was asked for.
class TypedInAdvance : public ui::LineReader {
public:
    explicit TypedInAdvance(std::vector<TypedLine> lines) : m_lines(lines.begin(), lines.end()) {}
    TypedLine ReadLine(std::string_view prompt, LinePurpose purpose) override {
        prompts.emplace_back(prompt);
        purposes.push_back(purpose);
        if (m_lines.empty()) return kCtrlD;
        TypedLine line = m_lines.front();
        m_lines.pop_front();
        return line;
    }
    std::vector<std::string> prompts;
    std::vector<LinePurpose> purposes;

private:
    std::deque<TypedLine> m_lines;
};

// A console at a terminal, its error stream kept.
struct Terminal {
    explicit Terminal(std::vector<TypedLine> lines) : reader(std::move(lines)) {
        console.SetInteractive(true);
        console.SetLineReader(&reader);
    }
    ~Terminal() { std::fclose(err); }
    std::string Said() { return Contents(err); }

    TypedInAdvance reader;
    std::FILE* err = std::tmpfile();
    ui::ConsoleFrontEnd console{nullptr, stdout, err};
};

TEST(ConsoleAnswers, AQuestionTakesWhatIsTypedItsDefaultOnEnterOrCtrlDAndEscapeCancels) {
    // clang-format off
    struct Case { const char* what; Buttons buttons; Answer byDefault; std::vector<TypedLine> typed;
                  Answer answer; std::size_t asked; const char* said; };
    const Case cases[] = {
        {"typed", Buttons::YesNo, Answer::Yes, {Typed("n")}, Answer::No, 1, ""},
        {"typed, capital", Buttons::YesNoCancel, Answer::Yes, {Typed("Oui")}, Answer::Yes, 1, ""},
        {"typed cancel", Buttons::YesNoCancel, Answer::Yes, {Typed("a")}, Answer::Cancel, 1, ""},
        {"Enter", Buttons::YesNo, Answer::No, {Typed("")}, Answer::No, 1, ""},
        {"Ctrl-D", Buttons::YesNoCancel, Answer::Yes, {kCtrlD}, Answer::Yes, 1, "Réponse : Oui\n"},
        {"Ctrl-D, cancel by default", Buttons::YesNoCancel, Answer::Cancel, {kCtrlD}, Answer::Cancel, 1,
         "Réponse : Annuler\n"},
        {"Escape, yes/no/cancel", Buttons::YesNoCancel, Answer::Yes, {kEscape}, Answer::Cancel, 1,
         "Réponse : Annuler\n"},
        {"Escape, yes/no", Buttons::YesNo, Answer::Yes, {kEscape}, Answer::No, 1, "Réponse : Non\n"},
        {"asked again until understood", Buttons::YesNo, Answer::Yes, {Typed("quoi"), Typed("a"), Typed("o")},
         Answer::Yes, 3, ""},
    };
    // clang-format on
    for (const Case& c : cases) {
        Terminal terminal(c.typed);
        EXPECT_EQ(terminal.console.Ask("Remplacer ?", ui::kCaption, c.buttons, c.byDefault), c.answer)
            << c.what;
        ASSERT_EQ(terminal.reader.prompts.size(), c.asked) << c.what;
        for (LinePurpose purpose : terminal.reader.purposes)
            EXPECT_EQ(purpose, LinePurpose::Answer) << c.what;
        // The question on its own line, then what the keys answered.
        EXPECT_EQ(terminal.Said(), std::string("PYRALIS : Remplacer ?\n") + c.said) << c.what;
    }
}

TEST(ConsoleAnswers, AFileChoiceOffersItsStartPathAndEscapeChoosesNone) {
    // clang-format off
    struct Case { const char* what; std::string start; TypedLine typed; std::optional<std::string> chosen;
                  const char* said; };
    const Case cases[] = {
        {"typed", "chantier.geo", Typed("autre chantier.geo"), "autre chantier.geo", ""},
        {"Enter", "chantier.geo", Typed(""), "chantier.geo", ""},
        {"Enter, nothing offered", "", Typed(""), std::nullopt, ""},
        {"Ctrl-D", "chantier.geo", kCtrlD, "chantier.geo", "Réponse : chantier.geo\n"},
        {"Ctrl-D, nothing offered", "", kCtrlD, std::nullopt, "Réponse : aucun fichier\n"},
        {"Escape", "chantier.geo", kEscape, std::nullopt, "Réponse : aucun fichier\n"},
    };
    // clang-format on
    for (const Case& c : cases) {
        Terminal terminal({c.typed});
        const ui::FileChoice choice{false, "Sélectionnez la GéoBase :", "", "geo", c.start};
        EXPECT_EQ(terminal.console.ChooseFile(choice), c.chosen) << c.what;
        EXPECT_EQ(terminal.reader.prompts,
                  std::vector<std::string>{"Sélectionnez la GéoBase : [" + c.start + "] "})
            << c.what;
        EXPECT_EQ(terminal.reader.purposes, std::vector<LinePurpose>{LinePurpose::File}) << c.what;
        EXPECT_EQ(terminal.Said(), c.said) << c.what;
    }
}

TEST(ConsoleAnswers, ThePromptHandsOnTheLineOrTheKeyForACommand) {
    Terminal terminal({Typed("CalculV0 --type toutes"), kEscape, kCtrlD});
    for (const TypedLine& expected : {Typed("CalculV0 --type toutes"), kEscape, kCtrlD}) {
        const TypedLine typed = terminal.console.Prompt("Commande : ");
        EXPECT_EQ(typed.kind, expected.kind);
        EXPECT_EQ(typed.text, expected.text);
    }
    EXPECT_EQ(terminal.reader.purposes, std::vector<LinePurpose>(3, LinePurpose::Command));
    EXPECT_EQ(terminal.reader.prompts.at(0), "Commande : ");
}

// Without a line editor (input from a file or a pipe), a line that starts with Escape is the key, and the
// end of the input is Ctrl-D.
TEST(ConsoleAnswers, FromTheInputStreamEscapeStartsALineAndTheEndIsCtrlD) {
    std::FILE* in = std::tmpfile();
    std::fputs("n\n\nquoi\na\n\x1b\n\x1b\nautre.geo\n\x1b[A\nPyraCalInter\n", in);
    std::rewind(in);
    std::FILE* err = std::tmpfile();
    ui::ConsoleFrontEnd console(in, stdout, err);
    console.SetInteractive(true);
    const ui::FileChoice choice{false, "GéoBase :", "", "geo", "chantier.geo"};
    EXPECT_EQ(console.Ask("?", ui::kCaption, Buttons::YesNo, Answer::Yes), Answer::No);
    EXPECT_EQ(console.Ask("?", ui::kCaption, Buttons::YesNo, Answer::Yes), Answer::Yes) << "empty: default";
    EXPECT_EQ(console.Ask("?", ui::kCaption, Buttons::YesNoCancel, Answer::Yes), Answer::Cancel);
    EXPECT_EQ(console.Ask("?", ui::kCaption, Buttons::YesNoCancel, Answer::Yes), Answer::Cancel) << "Escape";
    EXPECT_EQ(console.ChooseFile(choice), std::nullopt) << "Escape";
    EXPECT_EQ(console.ChooseFile(choice), "autre.geo");
    EXPECT_EQ(console.Prompt("Commande : ").kind, TypedLine::Kind::Cancel) << "Escape and what follows";
    EXPECT_EQ(console.Prompt("Commande : ").text, "PyraCalInter");
    EXPECT_EQ(console.Ask("?", ui::kCaption, Buttons::YesNo, Answer::No), Answer::No) << "end: default";
    EXPECT_EQ(console.ChooseFile(choice), "chantier.geo") << "end: what is offered";
    EXPECT_EQ(console.Prompt("Commande : ").kind, TypedLine::Kind::End);
    const std::string said = Contents(err);
    EXPECT_NE(said.find("GéoBase : [chantier.geo] "), std::string::npos) << said;
    EXPECT_NE(said.find("(o)ui / (n)on / (a)nnuler [Oui] ? "), std::string::npos) << said;
    std::fclose(in);
    std::fclose(err);
}

} // namespace
