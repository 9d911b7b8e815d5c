// The skeleton every field-book reader shares, through a small fixed-width format made for the test:
// "S name HI", "M name AH AV DI HP", "C code", "H label=value", every line 24 characters long.
#include "FieldBookTestSupport.h"
#include "core/Numbers.h"
#include "fieldbook/FieldBookTexts.h"
#include "fieldbook/TableCode.h"
#include "geobase/GeoFile.h"
#include "settings/CalcOptions.h"

#include <gtest/gtest.h>
#include <sstream>

using namespace pyr;

namespace {

class TestReader : public CFieldBookReader {
public:
    int begun = 0;
    int ended = 0;

protected:
    void BeginReading() override { ++begun; }
    void EndReading() override { ++ended; }
    void ReadLine(std::string_view line, int number) override {
        CheckLength(number, line, 24);
        std::istringstream in{std::string(line.substr(std::min<std::size_t>(2, line.size())))};
        std::vector<std::string> words;
        for (std::string word; in >> word;)
            words.push_back(word);
        const char kind = line.empty() ? ' ' : line[0];
        auto number_ = [&](std::size_t i) {
            double value = kUndefined;
            if (i < words.size()) ParseDouble(words[i], value);
            return value;
        };
        if (kind == 'S') {
            if (words.empty()) return LineMissing(number, "le nom de la station");
            AddStation(words[0], number_(1));
        } else if (kind == 'M') {
            std::string name, code;
            SplitNameAndCode(words.empty() ? "" : words[0], name, code);
            AddCode(code);
            AddMesure(name, number_(4), number_(1), number_(2), number_(3));
        } else if (kind == 'C') {
            AddCode(line.substr(2));
        } else if (kind == 'H') {
            std::string label, value;
            if (CCarnet::validComment(line.substr(2), label, value)) AddHeaderComment(label, value);
        } else if (kind == 'I') {
            LineError(fb::kNoStationForHI, number);
        } else {
            LineUnrecognised(number);
        }
    }
};

std::string Pad(std::string line) {
    line.resize(24, ' ');
    return line;
}

} // namespace

TEST(ReaderSkeleton, ItAnnouncesReadsEveryLineReportsAndCounts) {
    ReaderRun<TestReader> run;
    const std::string text = Pad("H Appareil=TCR 307") + "\r\n" + Pad("S S1 1.56") + "\n" + "S\r" +
                             Pad("M 101 12 100 25 1.3") + "\n" + Pad("X") + "\n" + Pad("I 1.2") + "\n" +
                             Pad("M 102 13 101 26 1.3") + "\r\n";
    const CCarnet& read = run.Read(text);
    const std::vector<std::string> expected{
        "",
        "Création de la GéoBase en cours ...",
        "Attention : ligne 3 de longueur incorrecte (1 / 24) !",
        "Erreur ligne 3 : donnée manquante pour le nom de la station !",
        "Erreur ligne 5 : donnée non reconnue !",
        "Erreur ligne 6 : pas de station pour cette hauteur d'instrument !",
        " ... terminée : 4 lignes écrites.",
    };
    EXPECT_EQ(run.frontEnd.lines, expected);
    EXPECT_EQ(run.reader.begun, 1);
    EXPECT_EQ(run.reader.ended, 1);
    ASSERT_EQ(Kinds(read), (std::vector<int>{kKindComment, kKindStation, kKindMesure, kKindMesure}));
    // Header information: the label padded before " = ".
    EXPECT_EQ(static_cast<const CComment*>(read.GetAt(0))->text(), "Appareil             = TCR 307");
    EXPECT_EQ(read.hiAt(1), 1.56);
    EXPECT_EQ(read.ahAt(3), 13.0);
    EXPECT_EQ(read.hpAt(3), 1.3);
}

// The instrument of the options comes first when asked: the one named, or the first of the list.
TEST(ReaderSkeleton, TheInstrumentIsTheFirstElementWhenAsked) {
    for (const char* name : {"TCR 307", "Inconnu"}) {
        ReaderRun<TestReader> run;
        run.choices.writeInstrument = true;
        run.choices.instrumentName = name;
        run.choices.instruments = {{kStandardInstrument},
                                   {"TCR 307", 0.034, 0.0012, 0.0003, 0.0005, 0.002, 2.0}};
        const CCarnet& read = run.Read(Pad("S S1 1.5") + "\n");
        ASSERT_EQ(Kinds(read), (std::vector<int>{kKindAppareil, kKindStation})) << name;
        const auto* i = read.As<CAppareil>(0);
        if (name != std::string("TCR 307")) {
            EXPECT_EQ(i->mat(), kStandardInstrument);
            continue;
        }
        EXPECT_EQ(std::tuple(i->mat(), i->constPrisme(), i->collVerticale(), i->sigmaAh(), i->sigmaAv(),
                             i->sigmaDi(), i->sigmaPpm()),
                  std::tuple(std::string(name), 0.034, 0.0012, 0.0003, 0.0005, 0.002, 2.0));
    }
}

// With interpretation a code becomes the command the table gives; without it, or unknown to the table,
// it stays as it stands. The name and code of a field are cut by the table's separator.
TEST(ReaderSkeleton, CodesAreInterpretedOrKeptAndCutFromTheName) {
    CTableCode table;
    ASSERT_TRUE(table.Init(DefaultCodeTable()));
    for (const bool interpret : {false, true}) {
        ReaderRun<TestReader> run;
        run.choices.interpret = interpret;
        run.reader.SetCodeTable(&table);
        EXPECT_EQ(ElementsSummary(run.Read(Pad("S S1 1.5") + "\n" + Pad("M 125ARB 12 100 25") + "\n" +
                                           Pad("C ZZZ 1") + "\n")),
                  interpret ? "1001 S1; 1019 Sym_Cir_Dia ARBRE; 1003 125; 1009 ZZZ 1; "
                            : "1001 S1; 1009 ARB; 1003 125; 1009 ZZZ 1; ");
    }
    // Without a table the whole field is the name.
    ReaderRun<TestReader> run;
    EXPECT_EQ(ElementsSummary(run.Read(Pad("S S1 1.5") + "\n" + Pad("M 125EXR 12 100 25") + "\n")),
              "1001 S1; 1003 125EXR; ");
}

// The message names the field book and says why in words, a folder or a missing file alike (a reader's
// own wording is checked with the Topcon reader).
TEST(ReaderSkeleton, AFileThatCannotBeOpenedIsSaidAndAddsNothing) {
    TempDir dir;
    const std::string missing = dir / "absent.txt";
    ReaderRun<TestReader> plain;
    ReaderRun<TestReader> folder;
    EXPECT_FALSE(plain.reader.Read(missing, plain.result) ||
                 folder.reader.Read(dir.Root().string(), folder.result));
    EXPECT_EQ(MessageTexts(plain.frontEnd),
              "Impossible d'ouvrir le fichier carnet !\n(" + missing + " : fichier ou dossier inexistant)");
    EXPECT_TRUE(MessageTexts(folder.frontEnd)
                    .starts_with("Impossible d'ouvrir le fichier carnet !\n(" + dir.Root().string() + " : "));
    EXPECT_TRUE(plain.frontEnd.lines.empty());
    EXPECT_EQ(plain.result.GetSize() + folder.result.GetSize(), 0);
}

// A book that ends in the middle of its last line (a transfer cut short) is told, with that line's
// number, before what the reader says of the line, and the line is read all the same. The end of a
// transfer (Ctrl-Z, EOT) or blanks after the last line end are no cut.
TEST(ReaderSkeleton, ALastLineWithoutItsEndIsReportedAndRead) {
    const std::string station = Pad("S S1 1.56") + "\r\n";
    const std::string cut = "sans fin de ligne, le carnet semble coupé ; elle est lue telle quelle !";
    const struct {
        const char* what;
        std::string text;
        int cutLine; // 0: no cut told
        int elements;
    } cases[] = {
        {"fin de ligne CR LF", station + Pad("M 101 12 100 25 1.3") + "\r\n", 0, 2},
        {"fin de ligne CR", station + Pad("M 101 12 100 25 1.3") + "\r", 0, 2},
        {"fin de transfert", station + "\x1a", 0, 1},
        {"EOT et Ctrl-Z", station + " \x04\x1a", 0, 1},
        {"blancs", station + "   ", 0, 1},
        {"ligne entière sans fin", station + Pad("M 101 12 100 25 1.3"), 2, 2},
        {"ligne coupée", station + "M 101 12 1", 2, 2},
        {"ligne coupée puis Ctrl-Z", station + "M 101 12 1 \x1a", 2, 2},
        {"seule ligne", "S S1", 1, 1},
    };
    for (const auto& c : cases) {
        ReaderRun<TestReader> run;
        const CCarnet& read = run.Read(c.text);
        const std::vector<std::string> reports = run.Reports();
        std::vector<std::string> told;
        std::copy_if(reports.begin(), reports.end(), std::back_inserter(told),
                     [&](const std::string& line) { return line.find(cut) != std::string::npos; });
        if (c.cutLine == 0) {
            EXPECT_TRUE(told.empty()) << c.what;
        } else {
            // Told once, first of what is said of that line.
            const std::string line = "ligne " + std::to_string(c.cutLine);
            EXPECT_EQ(told, std::vector<std::string>{"Attention : " + line + " " + cut}) << c.what;
            const auto first = std::find_if(reports.begin(), reports.end(), [&](const std::string& report) {
                return report.find(line) != std::string::npos;
            });
            EXPECT_TRUE(first != reports.end() && *first == told.front()) << c.what;
        }
        EXPECT_EQ(read.GetSize(), c.elements) << c.what;
    }
}

// A field book from a Windows machine: its accents survive, and the window says how it was read.
TEST(ReaderSkeleton, AWindows1252FieldBookKeepsItsAccents) {
    TempDir dir;
    WriteBytes(dir / "carnet.txt", Pad("H Op\xe9rateur=J. B\xe9rard") + "\n");
    ReaderRun<TestReader> run;
    ASSERT_TRUE(run.reader.Read(dir / "carnet.txt", run.result));
    ASSERT_EQ(run.result.GetSize(), 1);
    EXPECT_EQ(static_cast<const CComment*>(run.result.GetAt(0))->text(), "Opérateur            = J. Bérard");
    EXPECT_EQ(run.frontEnd.lines[0], "Carnet <" + dir / "carnet.txt" + "> : fichier lu en Windows-1252.");
}

// Unit conversions leave binary noise (a face-right reading turned by 200 gr, feet into metres, 0.1 + 0.2):
// the elements keep every digit an instrument records and nothing more, so the GéoBase reads as the book.
TEST(ReaderSkeleton, ValuesKeepTheRecordedDigitsWithoutTheNoiseOfConversions) {
    class Converting : public CFieldBookReader {
        void ReadLine(std::string_view, int) override {
            AddStation("S1", 0.1 + 0.2, 357.4134 - 200.0);
            AddMesure("P1", 5.0 * 0.3048, 157.41340000000002, 1.0 / 3.0, 12.34567891);
            AddPoint("P1", 651200.0 + 0.1 + 0.2, 6862300.1234567, kUndefined);
        }
    };
    ReaderRun<Converting> run;
    const CCarnet& read = run.Read("une ligne\n");
    ASSERT_EQ(read.GetSize(), 3);
    EXPECT_EQ(ElementLine(*read.GetAt(0), read.GetType(0)), "1001\tS1\t0.3\t157.4134");
    EXPECT_EQ(ElementLine(*read.GetAt(1), read.GetType(1)),
              "1003\tP1\t1.524\t157.4134\t0.33333333\t12.345679");
    EXPECT_EQ(ElementLine(*read.GetAt(2), read.GetType(2)), "1006\tP1\t651200.3\t6862300.123457\t-999999\t-");
}
