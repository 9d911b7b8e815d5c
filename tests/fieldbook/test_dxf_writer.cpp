// The DXF writer: the file's structure, its numbers and texts, the extents it computes, and an
// independent reading of its files by ezdxf (tests/fieldbook/dxf_check.py).
#include "DxfTestSupport.h"
#include "TestSupport.h"
#include "fieldbook/DxfWriter.h"

#include <array>
#include <charconv>
#include <clocale>
#include <cmath>
#include <gtest/gtest.h>
#include <map>
#include <string>
#include <sys/wait.h>
#include <vector>

namespace dxftest {

// One group of a DXF file: its code and its value.
struct Group {
    int code;
    std::string value;
};

// The groups of a DXF text, each line ended by CRLF; a line that is no code, or a bare LF, fails the test.
std::vector<Group> Groups(const std::string& text) {
    std::vector<Group> groups;
    std::vector<std::string> lines;
    std::size_t start = 0;
    while (start < text.size()) {
        const std::size_t end = text.find("\r\n", start);
        if (end == std::string::npos) {
            ADD_FAILURE() << "the file does not end with CRLF";
            break;
        }
        lines.push_back(text.substr(start, end - start));
        if (lines.back().find('\n') != std::string::npos) ADD_FAILURE() << "bare LF in " << lines.back();
        start = end + 2;
    }
    if (lines.size() % 2 != 0) ADD_FAILURE() << "odd number of lines";
    for (std::size_t i = 0; i + 1 < lines.size(); i += 2) {
        int code = -1;
        const auto result = std::from_chars(lines[i].data(), lines[i].data() + lines[i].size(), code);
        if (result.ec != std::errc() || result.ptr != lines[i].data() + lines[i].size())
            ADD_FAILURE() << "line " << i + 1 << " is no group code: " << lines[i];
        groups.push_back({code, lines[i + 1]});
    }
    return groups;
}

// An entity (or a table entry, or a header variable) as its groups, by code; a code met twice keeps
// every value.
struct Entity {
    std::string kind;
    std::multimap<int, std::string> groups;

    std::string Get(int code) const {
        const auto found = groups.find(code);
        return found == groups.end() ? std::string() : found->second;
    }
    double Number(int code) const { return std::stod(Get(code)); }
    bool Has(int code) const { return groups.count(code) != 0; }
};

// The entities of a section ("ENTITIES", "TABLES", "BLOCKS"), in order.
std::vector<Entity> Section(const std::string& text, const std::string& name) {
    const std::vector<Group> groups = Groups(text);
    std::vector<Entity> entities;
    bool inside = false;
    for (std::size_t i = 0; i < groups.size(); ++i) {
        const Group& g = groups[i];
        if (g.code == 0 && g.value == "SECTION" && i + 1 < groups.size()) {
            inside = groups[i + 1].value == name;
            ++i;
            continue;
        }
        if (!inside) continue;
        if (g.code == 0) {
            if (g.value == "ENDSEC") break;
            entities.push_back({g.value, {}});
        } else if (!entities.empty()) {
            entities.back().groups.emplace(g.code, g.value);
        }
    }
    return entities;
}

// The header's variables, each as the groups that follow its name.
std::map<std::string, Entity> Header(const std::string& text) {
    std::map<std::string, Entity> variables;
    std::string current;
    for (const Group& g : Groups(text)) {
        if (g.code == 0 && g.value == "ENDSEC" && !current.empty()) break;
        if (g.code == 9) {
            current = g.value;
            variables[current].kind = current;
        } else if (!current.empty()) {
            variables[current].groups.emplace(g.code, g.value);
        }
    }
    return variables;
}

// A python3 that can import ezdxf: $PYR_PYTHON, the python3 of the PATH, or the system's.
std::string PythonWithEzdxf() {
    static const std::string found = [] {
        std::vector<std::string> candidates;
        if (const char* chosen = std::getenv("PYR_PYTHON")) candidates.emplace_back(chosen);
        candidates.emplace_back("python3");
        candidates.emplace_back("/usr/bin/python3");
        for (const std::string& python : candidates)
            if (std::system((python + " -c 'import ezdxf' >/dev/null 2>&1").c_str()) == 0) return python;
        return std::string();
    }();
    return found;
}

// Runs dxf_check.py on the file with its arguments: its exit status (0: ezdxf reads the file, the audit
// is clean and everything expected is found) and what it printed. Fails the test when no python3 can
// import ezdxf.
int CheckWithEzdxf(const std::string& file, const std::string& arguments, std::string& report) {
    const std::string python = PythonWithEzdxf();
    if (python.empty()) {
        ADD_FAILURE() << "no python3 with ezdxf: the independent check of the DXF files needs python3-ezdxf "
                         "(scripts/install-deps installs it)";
        return -1;
    }
    const std::string output = file + ".check";
    const std::string command = python + " '" + PYR_SOURCE_DIR + "/tests/fieldbook/dxf_check.py' '" + file +
                                "' " + arguments + " >'" + output + "' 2>&1";
    const int status = std::system(command.c_str());
    report = ReadBytes(output);
    std::remove(output.c_str());
    return WIFEXITED(status) ? WEXITSTATUS(status) : -1;
}

} // namespace dxftest

namespace pyr::dxf {

namespace {

using namespace dxftest;

std::string LastNumber(const std::string& text, const std::string& kind, int code) {
    const auto entities = Section(text, "ENTITIES");
    for (auto e = entities.rbegin(); e != entities.rend(); ++e)
        if (e->kind == kind) return e->Get(code);
    return {};
}

TEST(DxfNames, EveryCodeGivesAValidLayerNameAlwaysTheSame) {
    const std::vector<std::pair<std::string, std::string>> cases = {
        {"mur", "MUR"},
        {"Bordure-T2_$", "BORDURE-T2_$"},
        {"façade élevée", "FACADE_ELEVEE"},
        {"Œil ÆSTHÉTIQUE ß", "OEIL_AESTHETIQUE_SS"},
        {"a.b/c\\d*e?f", "A_B_C_D_E_F"},
        {"x\xE9y", "X_Y"}, // not UTF-8: the stray byte is one character like any other
        {"Ω", "_"},
        {"", "0"},
        {std::string(40, 'k'), std::string(31, 'K')},
        // The cut comes after the accents are dropped: "æ" at the end leaves its "A".
        {std::string(30, 'a') + "é", std::string(30, 'A') + "E"},
        {std::string(30, 'a') + "æ", std::string(31, 'A')},
    };
    for (const auto& [code, name] : cases)
        EXPECT_EQ(ValidName(code), name) << code;

    DxfWriter writer;
    const int wall = writer.Layer("mur bas", kRed);
    EXPECT_EQ(writer.Layer("MUR.BAS", kGreen), wall) << "same valid name, same layer";
    EXPECT_EQ(writer.Layer("0"), 0);
    EXPECT_EQ(writer.LayerCount(), 2);
    EXPECT_EQ(writer.LayerName(wall), "MUR_BAS");
}

TEST(DxfWriter, FileHasItsSectionsTablesAndCrlfLines) {
    DxfWriter writer;
    const int wall = writer.Layer("Mur", kRed);
    writer.Point(wall, {1, 2, 3});
    const std::string text(writer.Finish());

    std::vector<std::string> sections;
    const auto groups = Groups(text);
    for (std::size_t i = 0; i + 1 < groups.size(); ++i)
        if (groups[i].code == 0 && groups[i].value == "SECTION") sections.push_back(groups[i + 1].value);
    EXPECT_EQ(sections, (std::vector<std::string>{"HEADER", "TABLES", "BLOCKS", "ENTITIES"}));
    ASSERT_FALSE(groups.empty());
    EXPECT_EQ(groups.back().value, "EOF");

    const auto header = Header(text);
    EXPECT_EQ(header.at("$ACADVER").Get(1), "AC1009");
    EXPECT_EQ(header.at("$DWGCODEPAGE").Get(3), "ANSI_1252");

    std::map<std::string, std::string> layers;
    std::vector<std::string> tables;
    for (const Entity& e : Section(text, "TABLES")) {
        if (e.kind == "TABLE") tables.push_back(e.Get(2));
        if (e.kind == "LAYER") layers[e.Get(2)] = e.Get(62) + " " + e.Get(6);
        if (e.kind == "LTYPE") {
            EXPECT_EQ(e.Get(2), "CONTINUOUS");
        }
        if (e.kind == "STYLE") {
            EXPECT_EQ(e.Get(2), "STANDARD");
        }
    }
    EXPECT_EQ(tables, (std::vector<std::string>{"VPORT", "LTYPE", "LAYER", "STYLE"}));
    EXPECT_EQ(layers, (std::map<std::string, std::string>{{"0", "7 CONTINUOUS"}, {"MUR", "1 CONTINUOUS"}}));
}

TEST(DxfWriter, NumbersAreRoundedWithAPointUnderAnyLocale) {
    const std::string previous = std::setlocale(LC_ALL, nullptr);
    const bool french = std::setlocale(LC_ALL, "fr_FR.UTF-8") != nullptr;
    const std::vector<std::pair<double, std::string>> cases = {
        {1234.5, "1234.5"},
        {3.0, "3"},
        {-2.25, "-2.25"},
        {0.1 + 0.2, "0.3"},
        {6862345.123456789, "6862345.123457"},
        {-0.0000001, "0"}, // rounds to nothing: no "-0"
        {-0.0, "0"},
        {0.0000015, "0.000002"},
        {1e12, "1000000000000"},
        {1e17, "100000000000000000"}, // beyond 2^52 at six decimals: written another way, still exact
        {-651234.1234, "-651234.1234"},
    };
    for (const auto& [value, written] : cases) {
        DxfWriter writer;
        writer.Point(0, {value, 0, 0});
        EXPECT_EQ(LastNumber(std::string(writer.Finish()), "POINT", 10), written) << value;
    }
    DxfWriter millimetres(3);
    millimetres.Point(0, {12.3456, 0.0005, 0});
    const std::string text(millimetres.Finish());
    EXPECT_EQ(LastNumber(text, "POINT", 10), "12.346");
    EXPECT_EQ(LastNumber(text, "POINT", 20), "0.001");
    std::setlocale(LC_ALL, previous.c_str());
    if (!french) GTEST_SKIP() << "fr_FR.UTF-8 is not installed: checked under the C locale only";
}

TEST(DxfWriter, ExtentsHoldEverythingDrawnTurnedTextsAndInsertedBlocksIncluded) {
    DxfWriter writer;
    // A mark 2 m long along X, based at its start.
    ASSERT_TRUE(writer.BeginBlock("repère"));
    writer.Line(0, {0, 0, 0}, {2, 0, 0});
    writer.EndBlock();
    writer.Point(0, {10, 20, 5});
    writer.Line(0, {-3, 7, -1}, {30, -4, 0});
    // "AB", 1 m high, turned 100 gr (reading northward): its estimated box, 1.6 m by 1 m, goes up from
    // y = 50 to 51.6 and left from x = 0 to -1.
    writer.Text(0, {0, 50, 0}, "AB", {.height = 1.0, .rotationGrads = 100.0});
    // The mark, twice as big and turned 100 gr at (200, 0): from (200, 0) to (200, 4).
    ASSERT_TRUE(writer.Insert(0, "REPERE", {200, 0, 0}, 2.0, 100.0));
    // A block's own drawing counts only where it is inserted.
    const auto header = Header(std::string(writer.Finish()));
    const Entity& min = header.at("$EXTMIN");
    const Entity& max = header.at("$EXTMAX");
    EXPECT_NEAR(min.Number(10), -3.0, 1e-6);
    EXPECT_NEAR(min.Number(20), -4.0, 1e-6);
    EXPECT_NEAR(min.Number(30), -1.0, 1e-6);
    EXPECT_NEAR(max.Number(10), 200.0, 1e-6);
    EXPECT_NEAR(max.Number(20), 51.6, 1e-6);
    EXPECT_NEAR(max.Number(30), 5.0, 1e-6);
    EXPECT_NEAR(header.at("$LIMMAX").Number(20), 51.6, 1e-6);
}

TEST(DxfWriter, EntitiesCarryTheirGroups) {
    DxfWriter writer;
    const int road = writer.Layer("route", kBlue);
    const std::array<Point3, 3> vertices = {{{0, 0, 1}, {10, 0, 2}, {10, 10, 3}}};
    writer.Polyline(road, vertices, true, true);
    writer.Polyline(road, vertices, false, false);
    writer.Polyline(road, std::span(vertices).first(1), false, true); // one vertex: nothing
    writer.Text(
        road, {5, 5, 0}, "Centré",
        {.height = 0.25, .rotationGrads = 50.0, .horizontal = HAlign::Center, .vertical = VAlign::Middle});
    writer.Text(road, {5, 5, 0}, "", {}); // nothing
    ASSERT_TRUE(writer.BeginBlock("borne", {1, 1, 0}));
    writer.Point(0, {1, 1, 0});
    writer.EndBlock();
    writer.Insert(road, "BORNE", {7, 8, 9}, 0.5, 200.0);
    const std::string text(writer.Finish());

    std::vector<std::string> kinds;
    for (const Entity& e : Section(text, "ENTITIES"))
        kinds.push_back(e.kind);
    EXPECT_EQ(kinds, (std::vector<std::string>{"POLYLINE", "VERTEX", "VERTEX", "VERTEX", "SEQEND", "POLYLINE",
                                               "VERTEX", "VERTEX", "VERTEX", "SEQEND", "TEXT", "INSERT"}));
    const auto entities = Section(text, "ENTITIES");
    EXPECT_EQ(entities[0].Get(70), "9") << "closed 3D polyline";
    EXPECT_EQ(entities[1].Get(70), "32") << "3D vertex";
    EXPECT_EQ(entities[3].Get(30), "3");
    EXPECT_EQ(entities[5].Get(70), "0");
    EXPECT_EQ(entities[5].Get(30), "1") << "a 2D polyline lies at its first vertex's Z";
    EXPECT_EQ(entities[8].Get(30), "1");
    const Entity& label = entities[10];
    EXPECT_EQ(label.Get(8), "ROUTE");
    EXPECT_EQ(label.Get(1), "Centr\xE9") << "Windows-1252";
    EXPECT_EQ(label.Get(40), "0.25");
    EXPECT_EQ(label.Get(50), "45") << "degrees";
    EXPECT_EQ(label.Get(72), "1");
    EXPECT_EQ(label.Get(73), "2");
    EXPECT_EQ(label.Get(11), "5");
    const Entity& insert = entities[11];
    EXPECT_EQ(insert.Get(2), "BORNE");
    EXPECT_EQ(insert.Get(41), "0.5");
    EXPECT_EQ(insert.Get(50), "180");

    const auto blocks = Section(text, "BLOCKS");
    ASSERT_EQ(blocks.size(), 3u);
    EXPECT_EQ(blocks[0].kind, "BLOCK");
    EXPECT_EQ(blocks[0].Get(2), "BORNE");
    EXPECT_EQ(blocks[1].kind, "POINT");
    EXPECT_EQ(blocks[2].kind, "ENDBLK");
}

TEST(DxfWriter, ADrawingMeasuredThenStreamedIsTheSameFile) {
    // Layers, every kind of entity, a block and its insertion, enough texts to fill several chunks.
    const auto draw = [](DxfWriter& writer) {
        const int road = writer.Layer("route", kBlue);
        const std::array<Point3, 3> vertices = {{{0, 0, 1}, {10, 0, 2}, {10, 10, 3}}};
        writer.Polyline(road, vertices, true, true);
        writer.Line(0, {-3, 7, -1}, {30, -4, 0});
        writer.Insert(writer.Layer("bornes", kRed), "BORNE", {200, 0, 0}, 2.0, 100.0);
        for (int i = 0; i < 40000; ++i) {
            const int layer = writer.Layer(i % 3 == 0 ? "mur" : "arbre");
            writer.Point(layer, {651000.0 + i * 0.25, 6862000.0 - i * 0.5, 40.0 + i % 7});
            writer.Text(layer, {651000.0 + i * 0.25, 6862000.5 - i * 0.5, 40.0}, "P" + std::to_string(i),
                        {.height = 0.5, .rotationGrads = 12.5});
            writer.Flush();
        }
    };
    const auto defineBlock = [](DxfWriter& writer) {
        ASSERT_TRUE(writer.BeginBlock("borne", {1, 1, 0}));
        writer.Line(0, {0, 0, 0}, {2, 0, 0});
        writer.EndBlock();
    };
    DxfWriter whole;
    defineBlock(whole);
    draw(whole);
    const std::string expected(whole.Finish());

    DxfWriter streamed;
    defineBlock(streamed);
    streamed.Measure();
    draw(streamed);
    std::string written;
    int pieces = 0;
    streamed.Stream([&](std::string_view bytes) {
        written += bytes;
        ++pieces;
    });
    EXPECT_FALSE(streamed.BeginBlock("autre")) << "blocks come before the stream";
    draw(streamed);
    EXPECT_TRUE(streamed.Finish().empty());
    EXPECT_GT(pieces, 2);
    EXPECT_EQ(written.size(), expected.size());
    EXPECT_TRUE(written == expected);
}

TEST(DxfWriter, RefusesWhatItCannotDraw) {
    DxfWriter writer;
    const double nan = std::nan("");
    EXPECT_FALSE(writer.Point(0, {nan, 0, 0}));
    EXPECT_FALSE(writer.Line(0, {0, 0, 0}, {HUGE_VAL, 0, 0}));
    EXPECT_FALSE(writer.Text(0, {0, 0, 0}, "A", {.height = nan}));
    const std::array<Point3, 2> vertices = {{{0, 0, 0}, {1, nan, 0}}};
    EXPECT_FALSE(writer.Polyline(0, vertices, false, false));
    EXPECT_FALSE(writer.Insert(0, "NONE", {0, 0, 0})) << "no such block";
    ASSERT_TRUE(writer.BeginBlock("B"));
    EXPECT_FALSE(writer.BeginBlock("C")) << "one block at a time";
    EXPECT_FALSE(writer.Insert(0, "B", {0, 0, 0})) << "inside a definition";
    writer.EndBlock();
    EXPECT_FALSE(writer.BeginBlock("b")) << "B exists";
    EXPECT_TRUE(writer.IsEmpty());
    const std::string text(writer.Finish());
    EXPECT_EQ(text.find("nan"), std::string::npos);
    EXPECT_EQ(text.find("inf"), std::string::npos);
    EXPECT_TRUE(Section(text, "ENTITIES").empty());
    EXPECT_EQ(Header(text).at("$EXTMAX").Get(10), "0");
}

TEST(DxfWriter, EzdxfReadsEveryEntityAndTheAuditFindsNothing) {
    TempDir folder;
    DxfWriter writer;
    const int points = writer.Layer("Points levés", kGreen);
    const int texts = writer.Layer("Textes", kYellow);
    writer.SetPointDisplay(35, 0.2);
    writer.Point(points, {651234.5678, 6862345.1234, 45.678});
    writer.Point(0, {-12.5, 0.000001, -3});
    writer.Text(texts, {651234.9, 6862345.2, 45.678}, "Église €5 Ω\tn°1", {.height = 0.5});
    writer.Text(texts, {0, 0, 0}, "turned",
                {.height = 2, .rotationGrads = 333.3, .horizontal = HAlign::Right, .vertical = VAlign::Top});
    writer.Line(points, {0, 0, 0}, {1, 1, 1});
    const std::array<Point3, 4> square = {{{0, 0, 0}, {5, 0, 0}, {5, 5, 0}, {0, 5, 0}}};
    writer.Polyline(points, square, true, false);
    writer.Polyline(points, square, false, true);
    writer.BeginBlock("Symbole arbre", {0, 0, 0});
    writer.Line(0, {-1, 0, 0}, {1, 0, 0});
    writer.Polyline(0, square, true, false);
    writer.Point(0, {0, 0, 0});
    writer.EndBlock();
    writer.Insert(points, "Symbole arbre", {100, 100, 10}, 1.5, 37.0);
    const std::string path = folder / "all.dxf";
    WriteBytes(path, writer.Finish());
    WriteBytes(folder / "points", "651234.5678 6862345.1234 45.678 POINTS_LEVES\n-12.5 0.000001 -3 0\n");
    WriteBytes(folder / "texts", "TEXTES\tÉglise €5 Ω n°1\nTEXTES\tturned\n");
    WriteBytes(folder / "layers", "0\nPOINTS_LEVES\nTEXTES\n");

    std::string report;
    EXPECT_EQ(CheckWithEzdxf(path,
                             "--points '" + folder / "points" + "' --texts '" + folder / "texts" +
                                 "' --layers '" + folder / "layers" + "'",
                             report),
              0)
        << report;
}

} // namespace

} // namespace pyr::dxf
