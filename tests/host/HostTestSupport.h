#pragma once

// What the tests of the module share: the folder of the built programs and modules, a front end that
// notes the host's state while a dialog runs, and the services as the module sees them.
#include "TestSupport.h"
#include "geobase/Carnet.h"
#include "host/HostTexts.h"
#include "host/Services.h"
#include "hostrt/HostRuntime.h"
#include "ui/Dialog.h"
#include "ui/ScriptedFrontEnd.h"

#include <filesystem>
#include <gtest/gtest.h>
#include <initializer_list>
#include <sstream>
#include <string>
#include <sys/resource.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>
#include <vector>

// A small Quendal-Pc field book, and the lines it adds to a GéoBase.
constexpr const char* kQuendalBook = "QUENDAL-PC;1\n"
                                     "STATION;S1;1.562\n"
                                     "REFERENCE;A1;1.3;323.76206;99.40145;260.0083\n"
                                     "MESURE;102;1.8;388.64623;99.18242;111.5994;POTEAU\n";
constexpr const char* kQuendalLines = "1001\tS1\t1.562\t-999999\n"
                                      "1002\tA1\t1.3\t323.76206\t99.40145\t260.0083\n"
                                      "1003\t102\t1.8\t388.64623\t99.18242\t111.5994\tPOTEAU\n";

inline std::string ProgramFile(const char* name) {
    return std::string(PYR_PROGRAM_DIR) + "/" + name;
}

// What a run of a built program came to: its exit status (-1 when a signal ended it) and what it wrote.
struct Outcome {
    int status = -1;
    std::string out;
    std::string err;
    std::vector<std::string> OutLines() const {
        std::vector<std::string> lines;
        std::istringstream text(out);
        for (std::string line; std::getline(text, line);)
            lines.push_back(line);
        return lines;
    }
};

inline bool Has(const std::string& text, const std::string& part) {
    return text.find(part) != std::string::npos;
}

// The parts of a text (what a command printed, a listing, a journal) in that order, and never an undefined
// value or a NaN written out.
inline void ExpectInOrder(const std::string& text, std::initializer_list<const char*> parts) {
    std::size_t at = 0;
    for (const char* part : parts) {
        at = text.find(part, at);
        ASSERT_NE(at, std::string::npos) << part << "\n" << text;
    }
    EXPECT_FALSE(Has(text, "-999999") || Has(text, "nan")) << text;
}

// The GéoBase a command left in that file.
inline pyr::CCarnet SavedGeoBase(const std::string& path) {
    pyr::CCarnet carnet;
    carnet.Load(nullptr, path);
    return carnet;
}

// Runs "pyralis --params Pyralis.ini <arguments>" in `folder` as a script runs it, with the parameter
// file and the registry of that folder, never the person's own; `input` is its standard input. With a
// limit, no file may grow past that many bytes, as on a full disk.
inline Outcome RunPyralis(const std::filesystem::path& folder, const std::string& arguments,
                          const std::string& input = "", rlim_t fileSizeLimit = RLIM_INFINITY,
                          const std::string& program = ProgramFile("pyralis")) {
    const std::filesystem::path inputFile = folder / "entree.txt", out = folder / "sortie.txt",
                                err = folder / "erreurs.txt";
    WriteBytes(inputFile.string(), input);
    const std::string command = "cd '" + folder.string() + "' && PYRALIS_REGISTRE='" +
                                (folder / "registre").string() + "' '" + program + "' --params Pyralis.ini " +
                                arguments + " <entree.txt >sortie.txt 2>erreurs.txt";
    const pid_t child = fork();
    if (child == 0) {
        const rlimit size{fileSizeLimit, fileSizeLimit};
        setrlimit(RLIMIT_FSIZE, &size);
        execl("/bin/sh", "sh", "-c", command.c_str(), static_cast<char*>(nullptr));
        _exit(127);
    }
    int raw = 0;
    waitpid(child, &raw, 0);
    Outcome outcome{WIFEXITED(raw) ? WEXITSTATUS(raw) : -1, ReadBytes(out.string()), ReadBytes(err.string())};
    std::filesystem::remove(inputFile);
    std::filesystem::remove(out);
    std::filesystem::remove(err);
    return outcome;
}

// A test that runs pyralis as a script does, in a folder of its own.
class PyralisTest : public ::testing::Test {
protected:
    Outcome Run(const std::string& arguments, rlim_t fileSizeLimit = RLIM_INFINITY) {
        return RunPyralis(dir.Root(), arguments, "", fileSizeLimit);
    }
    // The small job whose stations orient, under that name in the test's folder; its bytes.
    std::string Demo(const std::string& name) {
        std::filesystem::copy_file(std::string(PYR_SOURCE_DIR) + "/data/chantier-demo.geo", dir / name);
        return ReadBytes(dir / name);
    }
    // The GéoBase chantier.geo a command left.
    pyr::CCarnet Saved() const { return SavedGeoBase(dir / "chantier.geo"); }
    // `command` asked to save into chantier.geo made read-only fails, names it and leaves it as it was.
    // Root writes into a read-only file: the tests that check this run again as an unprivileged person.
    void ExpectReadOnlyGeoBaseKept(const std::string& command) {
        const std::string before = ReadBytes(dir / "chantier.geo");
        ASSERT_EQ(chmod((dir / "chantier.geo").c_str(), 0444), 0);
        const Outcome outcome = Run(command);
        EXPECT_EQ(outcome.status, 1);
        EXPECT_TRUE(Has(outcome.err, "chantier.geo")) << outcome.err;
        EXPECT_EQ(ReadBytes(dir / "chantier.geo"), before);
    }

    TempDir dir;
};

inline pyr::host::CPyrMainServices* RegisteredServices() {
    return static_cast<pyr::host::CPyrMainServices*>(
        acrxServiceDictionary()->at(pyr::host::kMainServicesName));
}

inline std::string SysVar(const char* name) {
    std::string value;
    acedGetVar(name, value);
    return value;
}

// The scripted front end, noting for each dialog what the host and the dialog looked like while it ran.
class RecordingFrontEnd : public pyr::ui::ScriptedFrontEnd {
public:
    struct Seen {
        std::string title;
        std::string geoBase;
        bool geoBaseNamed = false;
        std::string paramPath;
        std::string cmdecho;
        std::string ucsfollow;
        std::string resources;
    };
    std::vector<Seen> seen;
    std::string layerSetByDialog; // a dialog that changes the current layer, when not empty

    pyr::ui::DialogResult DoModal(pyr::ui::Dialog& dialog) override {
        pyr::ui::DialogResult result = ScriptedFrontEnd::DoModal(dialog);
        Seen now{dialog.Inputs().title,
                 dialog.GeoBase(),
                 dialog.GeoBaseNamed(),
                 dialog.Inputs().paramPath,
                 SysVar("CMDECHO"),
                 SysVar("UCSFOLLOW"),
                 RegisteredServices() ? RegisteredServices()->ResourceModule() : std::string()};
        seen.push_back(now);
        if (!layerSetByDialog.empty()) acedSetVar("CLAYER", layerSetByDialog);
        return result;
    }
};
