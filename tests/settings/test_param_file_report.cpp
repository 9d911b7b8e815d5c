#include "SettingsTestSupport.h"
#include "core/Strings.h"
#include "settings/ParamStore.h"
#include "settings/SettingsMessages.h"

#include <cerrno>
#include <gtest/gtest.h>

namespace pyr {
namespace {

// A parameter file that cannot be written is reported once for the many values a dialog writes in a
// row, and a file just written is not reported when a later write to it fails.
class ParamFileReport : public test::SettingsTest {
protected:
    std::vector<std::string> Texts() const {
        std::vector<std::string> texts;
        for (const auto& message : frontEnd.messages) {
            EXPECT_EQ(message.caption, "PYRALIS");
            EXPECT_EQ(message.icon, ui::kIconWarning);
            texts.push_back(message.text);
        }
        return texts;
    }
};

TEST_F(ParamFileReport, MissingFileIsReportedOnceThenAnotherFileAgain) {
    const std::string first = folder / "absent/Pyralis.ini";
    const std::string second = folder / "ailleurs/Autre.ini";
    EXPECT_FALSE(WriteParamInt(first, "A", "x", 1));
    EXPECT_FALSE(WriteParamDouble(first, "A", "y", 2.0));
    EXPECT_FALSE(WriteParamString(first, "B", "z", "trois"));
    // The same file spelled with other capitals is the same file.
    std::string shouted = first;
    shouted.replace(shouted.size() - 11, 11, "PYRALIS.INI");
    EXPECT_FALSE(WriteParamBool(shouted, "A", "w", 1));
    EXPECT_FALSE(WriteParamInt(second, "A", "x", 1));
    EXPECT_FALSE(WriteParamInt(second, "A", "x", 2));

    EXPECT_EQ(Texts(), (std::vector<std::string>{
                           first + " :\nFichier de paramètres inexistant !\n(Code d'erreur 2)",
                           second + " :\nFichier de paramètres inexistant !\n(Code d'erreur 2)",
                       }));
}

TEST_F(ParamFileReport, MissingFileInAnExistingFolderIsCreated) {
    EXPECT_TRUE(WriteParamInt(folder / "Nouveau.ini", "A", "x", 1));
    EXPECT_TRUE(frontEnd.messages.empty());
}

TEST_F(ParamFileReport, FileJustWrittenIsNotReportedWhenItFailsLater) {
    const std::string path = folder / "Pyralis.ini";
    EXPECT_TRUE(WriteParamInt(path, "A", "x", 1));
    // Something takes the file's place: writes to it fail from now on.
    std::filesystem::remove(path);
    std::filesystem::create_directory(path);
    EXPECT_FALSE(WriteParamInt(path, "A", "x", 2));
    EXPECT_TRUE(frontEnd.messages.empty());

    // Once another file has been written, the failing one is reported (it exists, as a folder).
    EXPECT_TRUE(WriteParamInt(folder / "Autre.ini", "A", "x", 1));
    EXPECT_FALSE(WriteParamInt(path, "A", "x", 3));
    EXPECT_EQ(Texts(), (std::vector<std::string>{
                           path + " :\nSauvegarde des paramètres imposssible !\n(Code d'erreur 21)",
                       }));
}

TEST_F(ParamFileReport, ExistingFileThatCannotBeWrittenIsNamedWithTheSystemCode) {
    if (geteuid() == 0) GTEST_SKIP() << "root writes read-only files";
    const std::string path = folder / "LectureSeule.ini";
    WriteBytes(path, "[A]\nx=0\n");
    ASSERT_EQ(chmod(path.c_str(), 0444), 0);
    EXPECT_FALSE(WriteParamInt(path, "A", "x", 1));
    EXPECT_FALSE(WriteParamInt(path, "A", "y", 1));
    EXPECT_EQ(Texts(), (std::vector<std::string>{
                           Sprintf(kMsgParamFileSaveFailed, path.c_str(), EACCES),
                       }));
    EXPECT_EQ(ReadBytes(path), "[A]\nx=0\n");
}

TEST_F(ParamFileReport, NullAndEmptyNames) {
    EXPECT_FALSE(WriteParamInt(kNullParamPath, "A", "x", 1));
    EXPECT_FALSE(WriteParamInt(kNullParamPath, "A", "y", 1));
    // The memory starts empty: the empty name counts as already reported until another name takes
    // its place.
    EXPECT_FALSE(WriteParamInt("", "A", "x", 1));
    EXPECT_FALSE(WriteParamInt("", "A", "x", 1));
    EXPECT_FALSE(WriteParamInt(kNullParamPath, "A", "x", 1));
    EXPECT_EQ(Texts(), (std::vector<std::string>{
                           "Pointeur nul pour le fichier de paramètres !\n(Code d'erreur 22)",
                           "Pas de nom pour le fichier de paramètres !\n(Code d'erreur 2)",
                           "Pointeur nul pour le fichier de paramètres !\n(Code d'erreur 22)",
                       }));
}

TEST_F(ParamFileReport, UnreadableFileIsNeverWrittenOver) {
    if (geteuid() == 0) GTEST_SKIP() << "root reads every file";
    const std::string path = folder / "Illisible.ini";
    WriteBytes(path, "[A]\nprecieux=1\n");
    ASSERT_EQ(chmod(path.c_str(), 0200), 0);
    EXPECT_FALSE(WriteParamInt(path, "A", "x", 1));
    ASSERT_EQ(chmod(path.c_str(), 0600), 0);
    EXPECT_EQ(ReadBytes(path), "[A]\nprecieux=1\n");
    EXPECT_EQ(frontEnd.messages.size(), 1u);
}

} // namespace
} // namespace pyr
