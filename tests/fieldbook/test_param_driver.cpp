// The parameter set of a format: the files shipped in Config are right, a wrong value is refused with its
// reason, the delimited and columnar layouts are read into their fields.
#include "FieldBookTestSupport.h"
#include "fieldbook/ParamDriver.h"

#include <gtest/gtest.h>
#include <tuple>

using namespace pyr;

namespace {

std::string Shipped(const char* name) {
    return std::string(PYR_SOURCE_DIR) + "/data/Config/" + name;
}

} // namespace

TEST(ParamDriver, EveryShippedFileValidatesAndHoldsEveryKeyOfItsFormat) {
    for (const auto& info : FieldBookFormats()) {
        if (!info.parameterFile) continue;
        ui::ScriptedFrontEnd frontEnd;
        CParamDriver driver("", Shipped(info.parameterFile), info.format);
        EXPECT_TRUE(driver.Load(&frontEnd)) << info.parameterFile;
        EXPECT_TRUE(frontEnd.messages.empty()) << info.parameterFile;
        const std::string text = ReadBytes(Shipped(info.parameterFile));
        for (const auto& key : driver.Keys())
            EXPECT_NE(text.find(std::string("\n") + key.name + "="), std::string::npos)
                << info.parameterFile << " " << key.name;
    }
}

// Each fault refused with one message, naming the file; the wording is the driver's texts.
TEST(ParamDriver, AWrongValueIsRefusedWithItsReason) {
    TempDir dir;
    const auto load = [&](FieldBookFormat format, const char* name, const std::string& line,
                          ui::ScriptedFrontEnd& frontEnd) {
        WriteBytes(dir / name, "[Parametrage]\n" + line + "\n");
        return CParamDriver("", dir / name, format).Load(&frontEnd);
    };
    using enum FieldBookFormat;
    const std::tuple<FieldBookFormat, const char*, const char*> refused[] = {
        {Sokkia, "s.ini", "UniteAngles=radians"},
        {Separateur, "p.sep", "ChampsPoint=TYPE,MATRICULE,X,Y,W"},
        {Separateur, "p.sep", "LignesEntete=-1"},
        {Separateur, "p.sep", "Separateur=\"\""},
        {Separateur, "p.sep", "ChampsPoint=TYPE,MATRICULE,X,X"},  // a field twice
        {Separateur, "p.sep", "ChampsVisee=TYPE,MATRICULE,X"},    // not a sighting's field
        {Separateur, "p.sep", "ChampsStation=TYPE,HI"},           // no name
        {Separateur, "p.sep", "ChampsPoint=MATRICULE,X,Y"},       // TYPE in some lists only
        {Separateur, "p.sep", "ChampsPoint=TYPE:1-2,MATRICULE"},  // columns when delimited
        {Colonne, "p.col", "ChampsPoint=TYPE:1-2,MATRICULE"},     // no columns
        {Colonne, "p.col", "ChampsPoint=TYPE:1-2,MATRICULE:9-4"}, // columns backwards
    };
    for (const auto& [format, name, line] : refused) {
        ui::ScriptedFrontEnd fe;
        EXPECT_FALSE(load(format, name, line, fe)) << line;
        EXPECT_EQ(fe.messages.size(), 1u) << line;
        EXPECT_NE(MessageTexts(fe).find(dir / name), std::string::npos) << line;
    }
    ui::ScriptedFrontEnd unread;
    EXPECT_FALSE(CParamDriver("", dir / "absent.ini", Zeiss).Load(&unread));
    EXPECT_EQ(unread.messages.size(), 1u);
}

// What the surveyed layouts do not show: the TAB keyword, and a list left empty that is not read.
TEST(ParamDriver, TheTabKeywordAndAnEmptyListOfFields) {
    TempDir dir;
    WriteBytes(dir / "p.sep", "[Parametrage]\nSeparateur=TAB\nChampsVisee=\n");
    CParamDriver delimited("", dir / "p.sep", FieldBookFormat::Separateur);
    ASSERT_TRUE(delimited.Load(nullptr));
    const RecordLayout layout = delimited.Layout();
    EXPECT_EQ(layout.separator, "\t");
    EXPECT_TRUE(layout.sighting.empty());
}

// A new file edited starts as a copy of the installation's (its making and showing are checked with the
// reading dialog).
TEST(ParamDriver, EditingANewFileCopiesTheInstallations) {
    TempDir dir;
    ui::ScriptedFrontEnd frontEnd;
    CParamDriver(std::string(PYR_SOURCE_DIR) + "/data/", dir / "Copie.ini", FieldBookFormat::Wild)
        .Edit(frontEnd);
    EXPECT_EQ(ReadBytes(dir / "Copie.ini"), ReadBytes(Shipped("Wild.ini")));
}
