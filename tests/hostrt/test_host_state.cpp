#include "TestSupport.h"
#include "hostrt/HostRuntime.h"

#include <gtest/gtest.h>
#include <stdexcept>

namespace {

namespace fs = std::filesystem;

std::string Var(std::string_view name) {
    std::string value;
    return acedGetVar(name, value) == RTNORM ? value : "<erreur>";
}

class SysVars : public ::testing::Test {
protected:
    void TearDown() override { pyr::ResetSysVars(); }
};

TEST_F(SysVars, NamesIgnoreCaseAndOnlyKnownVariablesTakeFittingValues) {
    EXPECT_EQ(Var("DWGPREFIX"), fs::current_path().string() + "/");
    EXPECT_EQ(acedSetVar("cmdecho", "0"), RTNORM);
    EXPECT_EQ(Var("CmdEcho"), "0");
    EXPECT_EQ(acedSetVar("clayer", "Points levés"), RTNORM); // a text variable takes any text
    EXPECT_EQ(Var("CLAYER"), "Points levés");
    EXPECT_EQ(acedSetVar("AFLAGS", "-4"), RTNORM);
    for (const char* bad : {"", "oui", "1.5", "1 ", " 1"})
        EXPECT_EQ(acedSetVar("UCSFOLLOW", bad), RTERROR) << '"' << bad << '"';
    EXPECT_EQ(Var("UCSFOLLOW"), "0");

    std::string value = "<inchangé>";
    EXPECT_EQ(acedSetVar("NEXISTEPAS", "1"), RTERROR);
    EXPECT_EQ(acedGetVar("NEXISTEPAS", value), RTERROR); // not made by the refused setting
    EXPECT_EQ(value, "<inchangé>");
}

TEST_F(SysVars, AHostDefinesFurtherVariablesAndAResetForgetsThem) {
    pyr::DefineSysVar("PYRECHELLE", "500", pyr::SysVarKind::Integer);
    EXPECT_EQ(acedSetVar("pyrechelle", "mille"), RTERROR);
    EXPECT_EQ(Var("PYRECHELLE"), "500");
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
        fs::current_path(root / "Travail");
    }
    void TearDown() override {
        fs::current_path(old);
        pyr::SetSupportPath({});
    }
    std::string Found(std::string_view name) {
        std::string found;
        return acedFindFile(name, found) == RTNORM ? found : "<rien>";
    }

    TempDir root;
    fs::path old = fs::current_path();
};

TEST_F(FindFile, TheNameAsGivenComesBeforeTheSupportFoldersInOrderWithEitherSlash) {
    pyr::SetSupportPath({root / "Appui1", root / "Appui2"});
    WriteBytes(root / "Appui2/Srv.arx", "2");
    EXPECT_EQ(Found("Srv.arx"), root / "Appui2/Srv.arx");
    WriteBytes(root / "Appui1/Srv.arx", "1");
    EXPECT_EQ(Found("Srv.arx"), root / "Appui1/Srv.arx");
    WriteBytes(root / "Travail/Srv.arx", "0");
    EXPECT_EQ(Found("Srv.arx"), root / "Travail/Srv.arx");
    EXPECT_EQ(Found(root / "Appui2/Srv.arx"), root / "Appui2/Srv.arx");
    for (const char* nothing : {"Absent.arx", "", "../Programmes"}) // a folder is no file
        EXPECT_EQ(Found(nothing), "<rien>") << nothing;

    // Windows-style names, to a sibling folder or under the support folders, written either way.
    WriteBytes(root / "Programmes/Srv.arx", "");
    EXPECT_EQ(Found("..\\Programmes\\Srv.arx"), root / "Programmes/Srv.arx");
    pyr::SetSupportPath({root.Root().string() + "\\Appui1"});
    fs::create_directories(root / "Appui1/Programmes");
    WriteBytes(root / "Appui1/Programmes/Srv.arx", "");
    EXPECT_EQ(Found("Programmes\\Srv.arx"), root / "Appui1/Programmes/Srv.arx");
}

TEST(Abort, TheDefaultEndsTheProgramAndAReplacementReceivesTheFormattedMessage) {
    EXPECT_EXIT(acrx_abort("Impossible de trouver le module <%s>!!!", "Pyr2000Srv.arx"),
                ::testing::ExitedWithCode(1), "Impossible de trouver le module <Pyr2000Srv.arx>!!!");

    std::string received;
    pyr::SetAbortHandler([&](const std::string& message) { received = message; });
    acrx_abort("Pas de service <%s>\nenregistré par le module <%s>!!!", "S", "M");
    EXPECT_EQ(received, "Pas de service <S>\nenregistré par le module <M>!!!");

    pyr::SetAbortHandler([](const std::string& message) { throw std::runtime_error(message); });
    EXPECT_THROW(acrx_abort("Impossible de charger le module <%s>!!!", "M"), std::runtime_error);
    pyr::SetAbortHandler({});
}

} // namespace
