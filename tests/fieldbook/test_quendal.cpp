// Quendal-Pc field books: what the writer writes, the reader gives back, and how the reader treats the
// lines a surveyor typed by hand.
#include "FieldBookTestSupport.h"
#include "fieldbook/ConfigQdl.h"
#include "fieldbook/QuendalReader.h"
#include "geobase/GeoFile.h"

#include <gtest/gtest.h>

using namespace pyr;

namespace {

// Every kind of element a field book carries, with the values that are easy to lose on the way: a text
// holding the separator, quotes and blanks at its ends, values missing or 0, a value whose shortest
// writing has 17 digits, accents.
CCarnet EveryKind() {
    CCarnet c;
    c.Add(std::make_unique<CComment>("Chantier « Les Prés » ; levé du 3 mars"), kKindComment);
    auto instrument = std::make_unique<CAppareil>("TCR 307", 0.0012, 0.034);
    instrument->setSigmaAh(0.0003);
    instrument->setSigmaAv(0.0005);
    instrument->setSigmaDi(0.002);
    instrument->setSigmaPpm(2);
    c.Add(std::move(instrument), kKindAppareil);
    auto s1 = std::make_unique<CPointGen>("S1", 651200.0, 6862300.0, 52.31, "BORNE");
    s1->setInvariantXY(true);
    s1->setInvariantZ(true);
    c.Add(std::move(s1), kKindPoint);
    auto a1 = std::make_unique<CPointGen>("A1", 651050.118, 6862512.447, "BORNE");
    a1->setInvariantXY(true);
    c.Add(std::move(a1), kKindPoint);
    c.Add(std::make_unique<CPointGen>("NGF1", 48.25), kKindPoint);
    c.Add(std::make_unique<CStation>("S1", 1.562, kUndefined, "ST"), kKindStation);
    c.Add(std::make_unique<CReference>("A1", 1.3, 323.76206, 99.40145, 260.0083), kKindReference);
    c.Add(std::make_unique<CCommande>("ExcentRad", "0.15"), kKindExcentrement);
    c.Add(std::make_unique<CMesure>("102", 0.0, 388.64623, kUndefined, 12.345678, "POTEAU \"bois\""),
          kKindMesure);
    c.Add(std::make_unique<CCommande>("ARB 4.5"), kKindCommand);
    auto lamp = std::make_unique<CCommande>("Lampadaire", "12 ; bis", "102");
    lamp->setSym(" ECL ");
    c.Add(std::move(lamp), kKindCommand);
    c.Add(std::make_unique<CCommande>("Sym_2Pts", "ARBRE 2", "102"), CommandKind("Sym_2Pts"));
    c.Add(std::make_unique<CLectAR>("R1", 1.2345, 25.5), kKindLectAR);
    c.Add(std::make_unique<CLectAV>("R2", 0.9876, kUndefined, "MIRE"), kKindLectAV);
    c.Add(std::make_unique<CStation>("S2", 0.0, 123.4567), kKindStation);
    c.Add(std::make_unique<CMesure>("103", 1.5, 0.0, 100.0, 0.0), kKindMesure);
    auto traverse = std::make_unique<CChemin>("POLY1");
    traverse->add("S1(1)");
    traverse->add("S2(1)");
    traverse->setClosed(true);
    c.Add(std::move(traverse), kKindChemin);
    return c;
}

} // namespace

TEST(Quendal, WhatIsWrittenIsReadBackElementForElement) {
    const CCarnet written = EveryKind();
    ASSERT_EQ(written.GetSize(), 17);
    const std::string text = CDlgConfigQdl::Text(written);
    ReaderRun<CQuendalReader> run;
    const CCarnet& read = run.Read(text);
    EXPECT_TRUE(run.Reports().empty()) << run.frontEnd.AllLines();
    ASSERT_EQ(read.GetSize(), written.GetSize()) << text;
    for (int i = 0; i < written.GetSize(); ++i) {
        EXPECT_EQ(read.GetType(i), written.GetType(i)) << i;
        EXPECT_EQ(ElementLine(*read.GetAt(i), read.GetType(i)),
                  ElementLine(*written.GetAt(i), written.GetType(i)));
    }
    // Written twice, the same text: nothing drifts.
    EXPECT_EQ(CDlgConfigQdl::Text(read), text);
}

// The quoting of texts and the writing of read lines are checked with the hand-written book below.
TEST(Quendal, TheRecordsAsASurveyorReadsThemAllOrOnlyThePointsOrTheObservations) {
    CCarnet c;
    c.Add(std::make_unique<CStation>("S1", 1.562, kUndefined, "ST"), kKindStation);
    c.Add(std::make_unique<CCommande>("ExcentRad", "0.15"), kKindExcentrement);
    c.Add(std::make_unique<CPointGen>("P", 1.0, 2.0), kKindPoint);
    const std::string observations = "STATION;S1;1.562;;ST\nCOMMANDE;ExcentRad;0.15\n";
    EXPECT_EQ(CDlgConfigQdl::Text(c), "QUENDAL-PC;1\n" + observations + "POINT;P;1;2\n");
    EXPECT_EQ(CDlgConfigQdl::Text(c, {true, false}, false), "POINT;P;1;2\n");
    EXPECT_EQ(CDlgConfigQdl::Text(c, {false, true}, false), observations);
}

// A book typed by hand: words in any case, decimal commas, blank lines, a comment with ';' unquoted,
// and lines the reader cannot use, each reported with its number and skipped.
TEST(Quendal, HandWrittenLinesAreReadOrReportedWithTheirNumber) {
    ReaderRun<CQuendalReader> run;
    const CCarnet& read = run.Read(ReadBytes(FieldBookData("saisie-main.qdl")));
    EXPECT_EQ(ReportHeads(run), "Erreur ligne 9\nErreur ligne 10\nErreur ligne 11\nAttention : ligne 12\n"
                                "Visée <104> sans aucune mesure : elle n'est pas ajoutée à la GéoBase !\n"
                                "Attention : ligne 15\n");
    // Written back as the writer writes: the comma read as a decimal point, "007" normalised, no distance.
    EXPECT_EQ(CDlgConfigQdl::Text(read), "QUENDAL-PC;1\n"
                                         "COMMENTAIRE;\"Levé du 3 mars; temps couvert\"\n"
                                         "STATION;S1;1.562\n"
                                         "REFERENCE;A1;1.3;323.76206;99.40145;260.0083\n"
                                         "MESURE;7;0;12;100\n"
                                         "MESURE;105;1.5;50;100;42.1;\"code ;x\"\n"
                                         "MESURE;108;1.5;50;100;42.1;C\n");
}

TEST(Quendal, ExportReplacesOrCompletesAFileWithOneHeader) {
    TempDir dir;
    CCarnet c;
    c.Add(std::make_unique<CPointGen>("P1", 1.0, 2.0, 3.0), kKindPoint);
    const std::string path = dir / "points.txt";
    EXPECT_TRUE(CDlgConfigQdl::Export(c, path, "w"));
    EXPECT_TRUE(CDlgConfigQdl::Export(c, path, "a"));
    EXPECT_EQ(ReadBytes(path), "QUENDAL-PC;1\nPOINT;P1;1;2;3\nPOINT;P1;1;2;3\n");
    EXPECT_TRUE(CDlgConfigQdl::Export(c, path, "w"));
    EXPECT_EQ(ReadBytes(path), "QUENDAL-PC;1\nPOINT;P1;1;2;3\n");

    ui::ScriptedFrontEnd frontEnd;
    EXPECT_FALSE(CDlgConfigQdl::Export(c, dir / "absent/points.txt", "w", {}, &frontEnd));
    EXPECT_EQ(MessageTexts(frontEnd), "Impossible d'écrire le fichier\n<" + dir / "absent/points.txt" +
                                          ">\n(fichier ou dossier inexistant).");
}
