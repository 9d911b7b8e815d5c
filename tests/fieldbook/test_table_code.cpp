// Code tables: read from their file, interpreting field codes into commands, written back.
#include "fieldbook/TableCode.h"
#include "geobase/Elements.h"
#include "geobase/Kinds.h"
#include "ui/PyrTxtWnd.h"
#include "ui/ScriptedFrontEnd.h"

#include <filesystem>
#include <fstream>
#include <gtest/gtest.h>
#include <sstream>

using namespace pyr;

namespace {

const std::string kData = std::string(PYR_TEST_DATA) + "/fieldbook/";

std::string TempPath(const std::string& name) {
    return ::testing::TempDir() + "table_code_" + name;
}

std::string ReadBytes(const std::string& path) {
    std::ifstream in(path, std::ios::binary);
    std::ostringstream bytes;
    bytes << in.rdbuf();
    return bytes.str();
}

void WriteBytes(const std::string& path, const std::string& bytes) {
    std::ofstream(path, std::ios::binary) << bytes;
}

// What a field code gives: the command word, its parameters and its kind; an empty word when the code
// is not interpreted.
struct Interpreted {
    std::string word;
    std::string parameters;
    int kind = 0;
    bool operator==(const Interpreted&) const = default;
};

std::ostream& operator<<(std::ostream& out, const Interpreted& i) {
    return out << "{" << i.word << " | " << i.parameters << " | " << i.kind << "}";
}

Interpreted Interpret(const CTableCode& table, const std::string& fieldCode) {
    std::vector<std::string> words;
    table.Make_str_cmd(fieldCode, words);
    int kind = 0;
    std::unique_ptr<CElement> element = table.InterpreteTexte(words, kind);
    if (!element) return {"", "", kind};
    const auto* command = dynamic_cast<const CCommande*>(element.get());
    if (!command) return {"not a command", "", kind};
    return {command->word(), command->par(), kind};
}

struct TableCode : ::testing::Test {
    ui::ScriptedFrontEnd fe;
    CPyrTxtWnd txt{fe};
    CTableCode table;
};

// Kinds counted by hand in the list of commands: 1011 "PT_Sans_Ori" ... 1019 "Sym_Cir_Dia",
// 1021 "Sym_Orienté", 1023 "Sym_Car_Dia", 1042 "Liaison", 1055 "Texte_1Pt", 1065 "Inter_Dist".
TEST_F(TableCode, InterpretsTheCodesOfItsTableAndTheCommandWords) {
    ASSERT_TRUE(table.Init(kData + "chantier.cod", &txt));
    EXPECT_TRUE(fe.lines.empty()) << fe.AllLines();
    EXPECT_EQ(table.FileName(), kData + "chantier.cod");
    EXPECT_EQ(table.Separator(), "/");

    struct Case {
        const char* fieldCode;
        Interpreted expected;
    };
    const Case cases[] = {
        {"EXR 0.15", {"ExcentRad", "0.15", 1010}},
        {"exr -0.150", {"ExcentRad", "-0.150", 1010}},
        {"EXV 0.05", {"ExcentVer", "0.05", 1010}},
        {"EXR abc", {"", "", 1009}}, // an offset that is no number
        {"EXR", {"", "", 1009}},     // no offset at all
        {"EXR nan", {"", "", 1009}},
        {"ARB 0.60", {"Sym_Cir_Dia", "ARBRE 0.60", 1019}}, // the table's symbol comes first
        {"ARB", {"Sym_Cir_Dia", "ARBRE", 1019}},
        {"REG 108 109", {"Sym_Car_Dia", "REGARD 108 109", 1023}},
        {"MUR", {"Liaison", "\"Mur de clôture\"", 1042}},
        {"ÉCL", {"Sym_sans_Ori", "CANDELABRE", 1017}},
        {"TXT \"Rue des Lilas\"", {"Texte_1Pt", "\"Rue des Lilas\"", 1055}},
        {"/ARB 0.6", {"Sym_Cir_Dia", "ARBRE 0.6", 1019}}, // the separator heading the code
        // Command words written in the field book as they stand, whatever their case and accents.
        {"ExcentTan 0.2", {"ExcentTan", "0.2", 1010}},
        {"excentver -0.05", {"ExcentVer", "-0.05", 1010}},
        {"Sym_Oriente TAMPON", {"Sym_Orienté", "TAMPON", 1021}},
        {"Inter_Dist 12 13", {"Inter_Dist", "12 13", 1065}},
        {"ExcentRad", {"", "", 1009}},
        {"XYZ 1", {"", "", 1009}},    // unknown
        {"Commande", {"", "", 1009}}, // the generic command is no interpretation
        {"ARBRE 1", {"", "", 1009}},  // a code is matched whole
        {"", {"", "", 1009}},
    };
    for (const Case& c : cases)
        EXPECT_EQ(Interpret(table, c.fieldCode), c.expected) << c.fieldCode;
}

TEST_F(TableCode, ParametersSplitBackIntoTheirWords) {
    ASSERT_TRUE(table.Init(kData + "chantier.cod", &txt));
    const Interpreted wall = Interpret(table, "MUR \"côté nord\" 2.5");
    std::vector<std::string> words;
    EXPECT_EQ(table.Make_str_cmd(wall.parameters, words), 3);
    EXPECT_EQ(words, (std::vector<std::string>{"Mur de clôture", "côté nord", "2.5"}));
}

TEST_F(TableCode, ReportsBadLinesWithTheirNumbersAndKeepsTheRest) {
    const std::string path = kData + "erreurs.cod";
    ASSERT_TRUE(table.Init(path, &txt));
    EXPECT_EQ(fe.lines, (std::vector<std::string>{
                            "Table de codes <" + path + "> :",
                            "Erreur ligne 4 : commande manquante pour le code <ARB> !",
                            "Erreur ligne 5 : commande <Liasion> inconnue pour le code <HAI> !",
                            "Erreur ligne 6 : code <exr> déjà défini ligne 3 !",
                            "Erreur ligne 8 : séparateur déjà défini ligne 2 !",
                        }));
    EXPECT_EQ(table.Separator(), kSeparatorUpper); // the first setting stands
    EXPECT_EQ(Interpret(table, "EXR 0.1"), (Interpreted{"ExcentRad", "0.1", 1010}));
    EXPECT_EQ(Interpret(table, "POT"), (Interpreted{"Sym_sans_Ori", "POTEAU", 1017}));
    EXPECT_EQ(Interpret(table, "HAI"), (Interpreted{"", "", 1009}));

    // Written back, the lines in error are kept as they were typed, to be put right by hand.
    const std::string saved = TempPath("erreurs.cod");
    ASSERT_TRUE(table.Save(saved));
    const std::string text = ReadBytes(saved);
    EXPECT_NE(text.find("\nARB\n"), std::string::npos) << text;
    EXPECT_NE(text.find("\nHAI  Liasion  HAIE\n"), std::string::npos) << text;
    EXPECT_NE(text.find("\nSéparateur = ±\n"), std::string::npos) << text;
}

TEST_F(TableCode, SavedTableReadsBackEqual) {
    ASSERT_TRUE(table.Init(kData + "chantier.cod", &txt));
    const std::string first = TempPath("first.cod");
    ASSERT_TRUE(table.Save(first));

    CTableCode again;
    ASSERT_TRUE(again.Init(first, &txt));
    EXPECT_TRUE(fe.lines.empty()) << fe.AllLines();
    EXPECT_EQ(again.Separator(), table.Separator());
    for (const char* code :
         {"EXR 0.15", "EXV 0.05", "ARB 0.60", "REG", "MUR 1", "écl", "TXT A", "XYZ", "EXR x"})
        EXPECT_EQ(Interpret(again, code), Interpret(table, code)) << code;

    // The comments stay, and a second writing changes nothing.
    const std::string text = ReadBytes(first);
    EXPECT_NE(text.find("; Table de codes du chantier : levé de voirie\n"), std::string::npos) << text;
    EXPECT_NE(text.find("écl  Sym_sans_Ori  CANDELABRE        ; accents et casse libres\n"),
              std::string::npos)
        << text;
    const std::string second = TempPath("second.cod");
    ASSERT_TRUE(again.Save(second));
    EXPECT_EQ(ReadBytes(second), text);
}

TEST_F(TableCode, SeparatorSettingsComeBackAsTheyWereSet) {
    for (const char* separator :
         {kSeparatorUpper, kSeparatorLower, kSeparatorSign, "--", " / ", "\"x\"", "="}) {
        table.SetSeparator(separator);
        const std::string path = TempPath("separator.cod");
        ASSERT_TRUE(table.Save(path));
        CTableCode again;
        ASSERT_TRUE(again.Init(path, &txt));
        EXPECT_EQ(again.Separator(), separator) << ReadBytes(path);
    }
    EXPECT_TRUE(fe.lines.empty()) << fe.AllLines();
}

TEST_F(TableCode, ReadsWindows1252AndKeepsItsLineEnds) {
    const std::string path = TempPath("windows.cod");
    WriteBytes(path, "S\xE9parateur = \xB1\r\nPI\xC9T  Passage_Pi\xE9ton  PASSAGE\r\n");
    ASSERT_TRUE(table.Init(path, &txt));
    EXPECT_TRUE(fe.lines.empty()) << fe.AllLines();
    EXPECT_EQ(table.Separator(), kSeparatorSign);
    EXPECT_EQ(Interpret(table, "piét"), (Interpreted{"Passage_Piéton", "PASSAGE", 1053}));
    EXPECT_EQ(Interpret(table, "+PIÉT"), (Interpreted{"Passage_Piéton", "PASSAGE", 1053}));

    const std::string saved = TempPath("windows-saved.cod");
    ASSERT_TRUE(table.Save(saved));
    EXPECT_EQ(ReadBytes(saved), "Séparateur = ±\r\nPIÉT  Passage_Piéton  PASSAGE\r\n");
}

TEST_F(TableCode, MissingFileLeavesAnEmptyTable) {
    ASSERT_TRUE(table.Init(kData + "chantier.cod", &txt));
    const std::string missing = TempPath("absente.cod");
    std::filesystem::remove(missing);
    EXPECT_FALSE(table.Init(missing, &txt));
    EXPECT_EQ(table.FileName(), "");
    EXPECT_EQ(table.Separator(), kSeparatorUpper);
    EXPECT_EQ(Interpret(table, "ARB 0.6"), (Interpreted{"", "", 1009}));
    // Command words need no table.
    EXPECT_EQ(Interpret(table, "ExcentRad 0.1"), (Interpreted{"ExcentRad", "0.1", 1010}));
    ASSERT_EQ(fe.lines.size(), 2u);
    EXPECT_EQ(fe.lines[0], "Impossible de lire la table de codes <" + missing + "> !");

    // No path is no table, and nothing to say.
    EXPECT_FALSE(table.Init("", &txt));
    EXPECT_FALSE(table.Init(::testing::TempDir(), nullptr)); // a folder
    EXPECT_EQ(fe.lines.size(), 2u);
}

TEST_F(TableCode, NewTableIsWrittenWithItsSettingAndHeader) {
    const std::string path = TempPath("nouvelle.cod");
    table.SetSeparator("#");
    ASSERT_TRUE(table.Save(path));
    EXPECT_EQ(ReadBytes(path), "; Table de codes PYRALIS\n"
                               "; code   commande   complément (symbole, calque, texte)   ; description\n"
                               "Séparateur = #\n");
    EXPECT_FALSE(table.Save(""));
    EXPECT_FALSE(table.Save(::testing::TempDir() + "dossier-absent/table.cod"));
}

TEST_F(TableCode, DefaultTableOfTheInstallationReadsWithoutError) {
    const std::string path = std::string(PYR_SOURCE_DIR) + "/data/Config/" + kDefaultCodeTable;
    ASSERT_TRUE(table.Init(path, &txt));
    EXPECT_TRUE(fe.lines.empty()) << fe.AllLines();
    EXPECT_EQ(table.Separator(), kSeparatorUpper);
    EXPECT_EQ(Interpret(table, "EXR 0.15"), (Interpreted{"ExcentRad", "0.15", 1010}));
    EXPECT_EQ(Interpret(table, "EXT 0.15"), (Interpreted{"ExcentTan", "0.15", 1010}));
    EXPECT_EQ(Interpret(table, "EXV 0.15"), (Interpreted{"ExcentVer", "0.15", 1010}));
    EXPECT_EQ(Interpret(table, "ARB 0.8").word, "Sym_Cir_Dia");
    // It is shipped in the layout the program writes.
    const std::string saved = TempPath("defaut.cod");
    ASSERT_TRUE(table.Save(saved));
    EXPECT_EQ(ReadBytes(saved), ReadBytes(path));
}

} // namespace
