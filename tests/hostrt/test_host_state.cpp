#include "TestSupport.h"
#include "hostrt/HostRuntime.h"

#include <filesystem>
#include <gtest/gtest.h>
#include <stdexcept>

namespace {

namespace fs = std::filesystem;

std::string Var(std::string_view name) {
    std::string value = "<inchangé>";
    if (acedGetVar(name, value) != RTNORM) return "<erreur>";
    return value;
}

class SysVars : public ::testing::Test {
protected:
    void TearDown() override { pyr::ResetSysVars(); }
};

TEST_F(SysVars, TheStandardVariablesStartWithTheHostsDefaults) {
    EXPECT_EQ(Var("CMDECHO"), "1");
    EXPECT_EQ(Var("UCSFOLLOW"), "0");
    EXPECT_EQ(Var("CLAYER"), "0");
    EXPECT_EQ(Var("AFLAGS"), "0");
    EXPECT_EQ(Var("DWGNAME"), "Dessin1.dwg");
    EXPECT_EQ(Var("DWGPREFIX"), fs::current_path().string() + "/");
}

TEST_F(SysVars, NamesIgnoreCaseAndUnknownOnesAreErrors) {
    EXPECT_EQ(acedSetVar("cmdecho", "0"), RTNORM);
    EXPECT_EQ(Var("CmdEcho"), "0");
    EXPECT_EQ(acedSetVar("clayer", "Points levés"), RTNORM);
    EXPECT_EQ(Var("CLAYER"), "Points levés");

    std::string value = "<inchangé>";
    EXPECT_EQ(acedGetVar("NEXISTEPAS", value), RTERROR);
    EXPECT_EQ(value, "<inchangé>");
    EXPECT_EQ(acedSetVar("NEXISTEPAS", "1"), RTERROR);
    EXPECT_EQ(Var("NEXISTEPAS"), "<erreur>");
}

TEST_F(SysVars, IntegerVariablesTakeOnlyWholeNumbers) {
    for (const char* bad : {"", "oui", "1.5", "1 ", " 1"}) {
        EXPECT_EQ(acedSetVar("UCSFOLLOW", bad), RTERROR) << '"' << bad << '"';
        EXPECT_EQ(Var("UCSFOLLOW"), "0");
    }
    EXPECT_EQ(acedSetVar("AFLAGS", "-4"), RTNORM);
    EXPECT_EQ(Var("AFLAGS"), "-4");
}

TEST_F(SysVars, AHostDefinesFurtherVariablesAndAResetForgetsThem) {
    pyr::DefineSysVar("PYRECHELLE", "500", pyr::SysVarKind::Integer);
    EXPECT_EQ(acedSetVar("pyrechelle", "1000"), RTNORM);
    EXPECT_EQ(acedSetVar("pyrechelle", "mille"), RTERROR);
    EXPECT_EQ(Var("PYRECHELLE"), "1000");
    pyr::DefineSysVar("DWGNAME", "levé.dwg");
    EXPECT_EQ(Var("DWGNAME"), "levé.dwg");
    pyr::ResetSysVars();
    EXPECT_EQ(Var("PYRECHELLE"), "<erreur>");
    EXPECT_EQ(Var("DWGNAME"), "Dessin1.dwg");
}

// A host installed as <root>/Travail (the current folder), with its modules in <root>/Programmes and
// two support folders.
class FindFile : public ::testing::Test {
protected:
    void SetUp() override {
        for (const char* folder : {"Travail", "Programmes", "Appui1", "Appui2"})
            fs::create_directories(root / folder);
        old = fs::current_path();
        fs::current_path(root / "Travail");
    }
    void TearDown() override {
        fs::current_path(old);
        pyr::SetSupportPath({});
    }
    std::string Found(std::string_view name) {
        std::string found = "<rien>";
        return acedFindFile(name, found) == RTNORM ? found : "<rien>";
    }

    TempDir root;
    fs::path old;
};

TEST_F(FindFile, TheNameAsGivenComesBeforeTheSupportFoldersWhichComeInOrder) {
    pyr::SetSupportPath({root / "Appui1", root / "Appui2"});
    WriteBytes(root / "Appui2/Srv.arx", "2");
    EXPECT_EQ(Found("Srv.arx"), root / "Appui2/Srv.arx");
    WriteBytes(root / "Appui1/Srv.arx", "1");
    EXPECT_EQ(Found("Srv.arx"), root / "Appui1/Srv.arx");
    WriteBytes(root / "Travail/Srv.arx", "0");
    EXPECT_EQ(Found("Srv.arx"), root / "Travail/Srv.arx");
    EXPECT_EQ(Found(root / "Appui2/Srv.arx"), root / "Appui2/Srv.arx");
    EXPECT_EQ(Found("Absent.arx"), "<rien>");
    EXPECT_EQ(Found(root / "Absent.arx"), "<rien>");
    EXPECT_EQ(Found(""), "<rien>");
}

TEST_F(FindFile, WindowsStylePathsToASiblingFolderAreFound) {
    WriteBytes(root / "Programmes/Srv.arx", "");
    EXPECT_EQ(Found("Srv.arx"), "<rien>");
    EXPECT_EQ(Found("..\\Programmes\\Srv.arx"), root / "Programmes/Srv.arx");
    EXPECT_EQ(Found("Programmes\\Srv.arx"), "<rien>");
    // Relative names are also tried under the support folders, written either way.
    pyr::SetSupportPath({root.Root().string() + "\\Appui1"});
    fs::create_directories(root / "Appui1/Programmes");
    WriteBytes(root / "Appui1/Programmes/Srv.arx", "");
    EXPECT_EQ(Found("Programmes\\Srv.arx"), root / "Appui1/Programmes/Srv.arx");
}

TEST_F(FindFile, AFolderIsNoFile) {
    pyr::SetSupportPath({root.Root().string()});
    EXPECT_EQ(Found("Programmes"), "<rien>");
}

TEST(Abort, TheDefaultEndsTheProgramWithTheMessageOnStandardError) {
    EXPECT_EXIT(acrx_abort("Impossible de trouver le module <%s>!!!", "Pyr2000Srv.arx"),
                ::testing::ExitedWithCode(1), "Impossible de trouver le module <Pyr2000Srv.arx>!!!");
}

TEST(Abort, AReplacedEndingReceivesTheFormattedMessage) {
    std::string received;
    pyr::SetAbortHandler([&](const std::string& message) { received = message; });
    acrx_abort("Pas de service <%s>\nenregistré par le module <%s>!!!", "S", "M");
    EXPECT_EQ(received, "Pas de service <S>\nenregistré par le module <M>!!!");

    pyr::SetAbortHandler([](const std::string& message) { throw std::runtime_error(message); });
    EXPECT_THROW(acrx_abort("Impossible de charger le module <%s>!!!", "M"), std::runtime_error);
    pyr::SetAbortHandler({});
}

} // namespace
