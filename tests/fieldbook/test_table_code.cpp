// Code tables: where a code starts in a name field, how a field code splits into words and is interpreted
// into a command, and the table read from and written back to its file.
#include "FieldBookTestSupport.h"
#include "fieldbook/TableCode.h"
#include "fieldbook/TableCodeFile.h"
#include "geobase/Elements.h"
#include "ui/PyrTxtWnd.h"
#include "ui/ScriptedFrontEnd.h"

#include <gtest/gtest.h>
#include <tuple>

using namespace pyr;

namespace {

const std::string kData = std::string(PYR_TEST_DATA) + "/fieldbook/";

// What a field code gives, as "word | parameters | kind"; an empty word when it is not interpreted.
std::string Interpret(const CTableCode& table, const std::string& fieldCode) {
    std::vector<std::string> words;
    table.Make_str_cmd(fieldCode, words);
    int kind = 0;
    const std::unique_ptr<CElement> element = table.InterpreteTexte(words, kind);
    const auto* command = dynamic_cast<const CCommande*>(element.get());
    if (element && !command) return "not a command";
    return (command ? command->word() + " | " + command->par() : std::string(" | ")) + " | " +
           std::to_string(kind);
}

struct TableCode : ::testing::Test {
    ui::ScriptedFrontEnd fe;
    CPyrTxtWnd txt{fe};
    CTableCode table;
    TempDir dir;
};

} // namespace

// Positions are byte indices of the UTF-8 field; accented letters count by their case, a lower-case letter
// belongs to the name under "A...Z", × is no letter. With "±" the earlier of + and - cuts; any other setting
// is a literal matched whole ("+-" is no sign setting); an empty one marks no code.
TEST(CodePosition, FollowsTheSeparatorSetting) {
    // clang-format off
    const std::tuple<const char*, const char*, std::size_t> cases[] = {
        {"125ARB 0.60", kSeparatorUpper, 3}, {"125", kSeparatorUpper, 3}, {"", kSeparatorUpper, 0},
        {"12a3ARB", kSeparatorUpper, 4}, {"12ÉCL", kSeparatorUpper, 2}, {"12éARB", kSeparatorUpper, 4},
        {"12×3ARB", kSeparatorUpper, 5}, {"125arb", kSeparatorLower, 3}, {"125ARB", kSeparatorLower, 6},
        {"12ARBé", kSeparatorLower, 5}, {"12œil", kSeparatorLower, 2}, {"AB-C+D", kSeparatorSign, 2},
        {"AB+C-D", kSeparatorSign, 2}, {"P12", kSeparatorSign, 3}, {"12/ARB", "/", 2},
        {"12-3--ARB", "--", 4}, {"12-3-ARB", "--", 8}, {"12 ARB", " ", 2}, {"12ÉARB", "É", 2},
        {"12ARB", "", 5}, {"12+EXR", "+-", 6}, {"12+-EXR", "+-", 2}};
    // clang-format on
    for (const auto& [field, separator, position] : cases)
        EXPECT_EQ(CodePosition(field, separator), position) << field << " / " << separator;
}

// A quote inside a word is a character; an unclosed one runs to the end.
TEST(MakeStrCmd, SplitsOnBlanksAndKeepsQuotedTextsWhole) {
    // clang-format off
    const std::pair<const char*, std::vector<std::string>> cases[] = {
        {"  EXR\t0.15  ", {"EXR", "0.15"}},
        {"TXT \"Mur de soutènement\" 2.5", {"TXT", "Mur de soutènement", "2.5"}},
        {"TXT \"non fermé", {"TXT", "non fermé"}}, {"TXT \"\" 1", {"TXT", "", "1"}},
        {"L'allée \"B\"x", {"L'allée", "B", "x"}}, {"A\"B C", {"A\"B", "C"}}, {" \t ", {}}};
    // clang-format on
    CTableCode table;
    std::vector<std::string> words{"left", "from", "before"};
    for (const auto& [text, expected] : cases) {
        EXPECT_EQ(table.Make_str_cmd(text, words), static_cast<int>(expected.size())) << text;
        EXPECT_EQ(words, expected) << text;
    }
}

// Kinds counted by hand in the list of commands: 1010 the offsets, 1017 "Sym_sans_Ori", 1019 "Sym_Cir_Dia",
// 1021 "Sym_Orienté", 1023 "Sym_Car_Dia", 1042 "Liaison", 1055 "Texte_1Pt"; 1009 a plain code.
TEST_F(TableCode, InterpretsTheCodesOfItsTableAndTheCommandWords) {
    ASSERT_TRUE(table.Init(kData + "chantier.cod", &txt));
    EXPECT_TRUE(fe.lines.empty()) << fe.AllLines();
    EXPECT_EQ(table.FileName(), kData + "chantier.cod");
    EXPECT_EQ(table.Separator(), "/");
    // An offset must be a number; the separator may head the code; the table's symbol or layer comes before
    // the parameters. Command words are interpreted as written, whatever their case and accents, but not the
    // generic "Commande"; a code is matched whole.
    // clang-format off
    const char* cases[][2] = {
        {"exr -0.150", "ExcentRad | -0.150 | 1010"}, {"EXV 0.05", "ExcentVer | 0.05 | 1010"},
        {"EXR nan", " |  | 1009"}, {"EXR", " |  | 1009"}, {"ARB", "Sym_Cir_Dia | ARBRE | 1019"},
        {"/ARB 0.6", "Sym_Cir_Dia | ARBRE 0.6 | 1019"},
        {"REG 108 109", "Sym_Car_Dia | REGARD 108 109 | 1023"},
        {"MUR", "Liaison | \"Mur de clôture\" | 1042"}, {"ÉCL", "Sym_sans_Ori | CANDELABRE | 1017"},
        {"TXT \"Rue des Lilas\"", "Texte_1Pt | \"Rue des Lilas\" | 1055"},
        {"excentver -0.05", "ExcentVer | -0.05 | 1010"},
        {"Sym_Oriente TAMPON", "Sym_Orienté | TAMPON | 1021"}, {"ExcentRad", " |  | 1009"},
        {"XYZ 1", " |  | 1009"}, {"Commande", " |  | 1009"}, {"ARBRE 1", " |  | 1009"}, {"", " |  | 1009"}};
    // clang-format on
    for (const auto& c : cases)
        EXPECT_EQ(Interpret(table, c[0]), c[1]) << c[0];
    // Parameters split back into their words.
    std::vector<std::string> words;
    table.Make_str_cmd("MUR \"côté nord\" 2.5", words);
    int kind = 0;
    const std::unique_ptr<CElement> wall = table.InterpreteTexte(words, kind);
    EXPECT_EQ(table.Make_str_cmd(dynamic_cast<const CCommande&>(*wall).par(), words), 3);
    EXPECT_EQ(words, (std::vector<std::string>{"Mur de clôture", "côté nord", "2.5"}));
}

TEST_F(TableCode, ReportsBadLinesWithTheirNumbersAndKeepsTheRest) {
    const std::string path = kData + "erreurs.cod";
    ASSERT_TRUE(table.Init(path, &txt));
    EXPECT_EQ(fe.AllLines(), "Table de codes <" + path +
                                 "> :\n"
                                 "Erreur ligne 4 : commande manquante pour le code <ARB> !\n"
                                 "Erreur ligne 5 : commande <Liasion> inconnue pour le code <HAI> !\n"
                                 "Erreur ligne 6 : code <exr> déjà défini ligne 3 !\n"
                                 "Erreur ligne 8 : séparateur déjà défini ligne 2 !");
    EXPECT_EQ(table.Separator(), kSeparatorUpper); // the first setting stands
    EXPECT_EQ(Interpret(table, "EXR 0.1"), "ExcentRad | 0.1 | 1010");
    EXPECT_EQ(Interpret(table, "POT"), "Sym_sans_Ori | POTEAU | 1017");
    EXPECT_EQ(Interpret(table, "HAI"), " |  | 1009");
    // Written back, the lines in error are kept as they were typed, to be put right by hand.
    ASSERT_TRUE(table.Save(dir / "erreurs.cod"));
    const std::string text = ReadBytes(dir / "erreurs.cod");
    for (const char* line : {"\nARB\n", "\nHAI  Liasion  HAIE\n", "\nSéparateur = ±\n"})
        EXPECT_NE(text.find(line), std::string::npos) << text;
}

// The table of the job and the one shipped with the program read back equal, comments kept; the shipped
// one is in the layout the program writes.
TEST_F(TableCode, SavedTablesReadBackEqual) {
    for (const std::string& path : {kData + "chantier.cod", DefaultCodeTable()}) {
        ASSERT_TRUE(table.Init(path, &txt));
        ASSERT_TRUE(table.Save(dir / "first.cod"));
        const std::string first = ReadBytes(dir / "first.cod");
        CTableCode again;
        ASSERT_TRUE(again.Init(dir / "first.cod", &txt));
        EXPECT_EQ(again.Separator(), table.Separator());
        for (const char* code : {"EXR 0.15", "EXV 0.05", "ARB 0.60", "REG", "MUR 1", "écl", "TXT A", "EXR x"})
            EXPECT_EQ(Interpret(again, code), Interpret(table, code)) << path << ": " << code;
        ASSERT_TRUE(again.Save(dir / "second.cod"));
        EXPECT_EQ(ReadBytes(dir / "second.cod"), first) << path;
        if (path == DefaultCodeTable())
            EXPECT_EQ(first, ReadBytes(path));
        else
            EXPECT_NE(first.find("écl  Sym_sans_Ori  CANDELABRE        ; accents et casse libres\n"),
                      std::string::npos)
                << first;
    }
    EXPECT_TRUE(fe.lines.empty()) << fe.AllLines();
}

TEST_F(TableCode, SeparatorSettingsComeBackAsTheyWereSet) {
    for (const char* separator :
         {kSeparatorUpper, kSeparatorLower, kSeparatorSign, "--", " / ", "\"x\"", "=", "#"}) {
        table.SetSeparator(separator);
        ASSERT_TRUE(table.Save(dir / "separator.cod"));
        CTableCode again;
        ASSERT_TRUE(again.Init(dir / "separator.cod", &txt));
        EXPECT_EQ(again.Separator(), separator) << ReadBytes(dir / "separator.cod");
    }
    EXPECT_TRUE(fe.lines.empty()) << fe.AllLines();
}

// A code in double quotes that, bare at the head of its line, would read as a comment or as the separator
// line is written back in its quotes, so the table saved says the same.
TEST(CodeTableText, CodesThatLookLikeACommentOrTheSeparatorLineKeepTheirQuotes) {
    const struct {
        const char* line;
        const char* written;
    } cases[] = {
        {"\"#12\" Liaison", "\"#12\"  Liaison\n"},
        {"\"Séparateur\" Liaison", "\"Séparateur\"  Liaison\n"},
        {"\"SEPARATEUR=x\" Liaison", "\"SEPARATEUR=x\"  Liaison\n"},
        {"\"a;b\" Liaison", "\"a;b\"  Liaison\n"},
        {"12# Liaison", "12#  Liaison\n"},
        {"Séparateurs Liaison", "Séparateurs  Liaison\n"},
    };
    for (const auto& c : cases) {
        const auto report = [&](int, const std::string& reason) {
            ADD_FAILURE() << c.line << ": " << reason;
        };
        const CodeTableContent table = ParseCodeTable(c.line, report);
        ASSERT_EQ(table.codes.size(), 1u) << c.line;
        const std::string written = FormatCodeTable(table);
        EXPECT_EQ(written.substr(written.find('\n') + 1), c.written) << written;
        const CodeTableContent back = ParseCodeTable(written, report);
        ASSERT_EQ(back.codes.size(), 1u) << written;
        EXPECT_EQ(back.lines[back.codes.begin()->second].code, table.lines[table.codes.begin()->second].code);
        EXPECT_EQ(back.separator, kSeparatorUpper) << written;
    }
}

TEST_F(TableCode, ReadsWindows1252AndKeepsItsLineEnds) {
    WriteBytes(dir / "windows.cod", "S\xE9parateur = \xB1\r\nPI\xC9T  Passage_Pi\xE9ton  PASSAGE\r\n");
    ASSERT_TRUE(table.Init(dir / "windows.cod", &txt));
    EXPECT_TRUE(fe.lines.empty()) << fe.AllLines();
    EXPECT_EQ(table.Separator(), kSeparatorSign);
    EXPECT_EQ(Interpret(table, "+piét"), "Passage_Piéton | PASSAGE | 1053");
    ASSERT_TRUE(table.Save(dir / "saved.cod"));
    EXPECT_EQ(ReadBytes(dir / "saved.cod"), "Séparateur = ±\r\nPIÉT  Passage_Piéton  PASSAGE\r\n");
}

TEST_F(TableCode, MissingFileLeavesAnEmptyTableAndANewOneIsWrittenToBeReadBack) {
    ASSERT_TRUE(table.Init(kData + "chantier.cod", &txt));
    EXPECT_FALSE(table.Init(dir / "absente.cod", &txt));
    EXPECT_EQ(table.FileName(), "");
    EXPECT_EQ(table.Separator(), kSeparatorUpper);
    EXPECT_EQ(Interpret(table, "ARB 0.6"), " |  | 1009");
    EXPECT_EQ(Interpret(table, "ExcentRad 0.1"), "ExcentRad | 0.1 | 1010"); // command words need no table
    ASSERT_EQ(fe.lines.size(), 2u);
    EXPECT_NE(fe.lines[0].find(dir / "absente.cod"), std::string::npos);
    // No path is no table, and nothing to say.
    EXPECT_FALSE(table.Init("", &txt));
    EXPECT_FALSE(table.Init(dir.Root().string(), nullptr)); // a folder
    EXPECT_EQ(fe.lines.size(), 2u);

    ASSERT_TRUE(table.Save(dir / "nouvelle.cod"));
    EXPECT_TRUE(CTableCode().Init(dir / "nouvelle.cod", &txt));
    EXPECT_FALSE(table.Save(""));
    EXPECT_FALSE(table.Save(dir / "dossier-absent/table.cod"));
}
