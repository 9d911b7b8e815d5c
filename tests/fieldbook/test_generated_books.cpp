// A generated field book in every format, converted by its reading command, gives the very GéoBase it
// gave before the readers and the GéoBase writer were made faster: byte for byte, the file kept in the
// test data. The books carry a station every 200 sightings and a code every ten, which is what the fast
// paths of the readers see most.
#include "FieldBookGenerator.h"
#include "FieldBookTestSupport.h"
#include "fieldbook/FieldBookConverter.h"
#include "fieldbook/FieldBookFormats.h"

#include <filesystem>
#include <gtest/gtest.h>

using namespace pyr;
namespace fs = std::filesystem;

namespace {

constexpr int kLines = 1000;

struct Conversion {
    TempDir dir;
    ScopedEnv registry{"PYRALIS_REGISTRE", dir / "registre"};
    ui::ScriptedFrontEnd frontEnd;
    CPyrTxtWnd txt{frontEnd};

    // Writes `text` as the book `name` (with the format's layout beside it), converts it through the
    // format's reading command into a new GéoBase beside it, and gives that GéoBase's bytes.
    std::string Convert(FieldBookFormat format, const std::string& name, const std::string& text) {
        const std::string book = dir / name;
        WriteBytes(book, text);
        frontEnd.dialogArguments = {book};
        if (const std::string layout = books::BookLayout(format); !layout.empty()) {
            const std::string layoutFile = BesideCarnet(book, FormatInfo(format).paramExtension);
            WriteBytes(layoutFile, layout);
            frontEnd.dialogArguments.insert(frontEnd.dialogArguments.end(), {"--parametrage", layoutFile});
        }
        // The delivered parameter files of the formats, as the program finds them.
        FieldBookConverter converter(format, &frontEnd, dir / "Pyralis.ini",
                                     std::string(PYR_SOURCE_DIR) + "/data/", &txt);
        EXPECT_EQ(RunConversion(converter, nullptr), ui::DialogResult::Ok) << frontEnd.AllLines();
        return ReadBytes(BesideCarnet(book, "geo"));
    }
};

std::string Kept(const std::string& name) {
    return ReadBytes(FieldBookData("generes/" + name + ".geo"));
}

std::string BookName(FieldBookFormat format) {
    return std::string(FormatInfo(format).command) + "." + books::BookExtension(format);
}

// The generated Quendal-Pc book with a comment holding accents, in `encoding`, halfway down: the
// encoding of a field book is told from all its bytes, wherever the first letter outside ASCII lies.
std::string WithAccentedComment(const std::string& comment) {
    std::string text = books::MakeFieldBook(FieldBookFormat::Quendal, kLines);
    std::size_t middle = text.size() / 2;
    middle = text.find('\n', middle) + 1;
    return text.insert(middle, "COMMENTAIRE;" + comment + "\r\n");
}

} // namespace

TEST(GeneratedBooks, EveryFormatGivesTheGeoBaseItGaveBefore) {
    for (const FieldBookFormatInfo& info : FieldBookFormats()) {
        SCOPED_TRACE(info.command);
        Conversion conversion;
        const std::string written =
            conversion.Convert(info.format, BookName(info.format), books::MakeFieldBook(info.format, kLines));
        EXPECT_TRUE(written == Kept(info.command)) << "la GéoBase de " << info.command << " a changé";
        // And a GéoBase read then saved is written again byte for byte.
        CCarnet carnet;
        ASSERT_TRUE(carnet.Load(nullptr, BesideCarnet(conversion.dir / BookName(info.format), "geo")));
        const std::string again = conversion.dir / "relue.geo";
        ASSERT_TRUE(carnet.Save(again));
        EXPECT_TRUE(ReadBytes(again) == written);
    }
}

TEST(GeneratedBooks, AnAccentHalfwayDownIsReadInTheBooksEncoding) {
    Conversion windows;
    const std::string fromWindows = windows.Convert(FieldBookFormat::Quendal, "LQuenda-1252.qdl",
                                                    WithAccentedComment("Lev\xE9 pr\xE8s du ch\xE2teau"));
    EXPECT_TRUE(fromWindows == Kept("LQuenda-1252"));
    EXPECT_NE(windows.frontEnd.AllLines().find("fichier lu en Windows-1252"), std::string::npos);

    Conversion utf8;
    const std::string fromUtf8 = utf8.Convert(FieldBookFormat::Quendal, "LQuenda-utf8.qdl",
                                              WithAccentedComment("Levé près du château"));
    EXPECT_TRUE(fromUtf8 == Kept("LQuenda-utf8"));
    EXPECT_EQ(utf8.frontEnd.AllLines().find("Windows-1252"), std::string::npos);
}
