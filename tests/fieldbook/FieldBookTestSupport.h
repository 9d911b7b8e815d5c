#pragma once

// What the tests of the field books share: a reader run on text in memory, with a scripted front end
// recording its text-window lines and its message boxes.
#include "TestSupport.h"
#include "fieldbook/FieldBookReader.h"
#include "fieldbook/ParamDriver.h"
#include "fieldbook/PointExport.h"
#include "geobase/Carnet.h"
#include "ui/PyrTxtWnd.h"
#include "ui/ScriptedFrontEnd.h"

#include <gtest/gtest.h>
#include <string>
#include <vector>

inline std::string FieldBookData(const std::string& name) {
    return std::string(PYR_TEST_DATA) + "/fieldbook/" + name;
}

inline std::string DefaultCodeTable() {
    return std::string(PYR_SOURCE_DIR) + "/data/Config/Defaut.cod";
}

// The texts of the message boxes shown, in order, "|" between them.
inline std::string MessageTexts(const pyr::ui::ScriptedFrontEnd& frontEnd) {
    std::string texts;
    for (const auto& message : frontEnd.messages)
        texts += (texts.empty() ? "" : "|") + message.text;
    return texts;
}

// The kinds of a GéoBase's elements, in order.
inline std::vector<int> Kinds(const pyr::CCarnet& carnet) {
    std::vector<int> kinds;
    for (int i = 0; i < carnet.GetSize(); ++i)
        kinds.push_back(carnet.GetType(i));
    return kinds;
}

// A reader with its choices, its window and its front end, reading into `result`.
template <class Reader>
struct ReaderRun {
    Reader reader;
    pyr::ReadingChoices choices;
    pyr::ui::ScriptedFrontEnd frontEnd;
    pyr::CPyrTxtWnd txt{frontEnd};
    pyr::CCarnet result;

    ReaderRun() {
        reader.SetChoices(choices);
        reader.SetTextWindow(&txt);
        reader.SetParent(&frontEnd);
    }
    pyr::CCarnet& Read(std::string_view text) {
        reader.ReadText(text, result);
        return result;
    }
    // The text-window lines between "Création ..." and "... terminée", the reports of the lines.
    std::vector<std::string> Reports() const {
        std::vector<std::string> reports;
        for (const auto& line : frontEnd.lines)
            if (!line.empty() && line.find("Création de la GéoBase") == std::string::npos &&
                line.find(" ... terminée") != 0)
                reports.push_back(line);
        return reports;
    }
};

// A run whose reader takes the settings of its parameter file from memory, set key by key.
template <class Reader, pyr::FieldBookFormat format>
struct DriverRun : ReaderRun<Reader> {
    pyr::CParamDriver driver{"", "", format};

    DriverRun() { this->reader.SetDriver(&driver); }
    DriverRun& Set(const char* key, std::string value) {
        driver.SetText(key, std::move(value));
        return *this;
    }
    pyr::CCarnet& ReadFile(const std::string& name) { return this->Read(ReadBytes(FieldBookData(name))); }
};

// The line reports of a run, one a line.
template <class Run>
std::string ReportText(const Run& run) {
    std::string reports;
    for (const std::string& line : run.Reports())
        reports += line + "\n";
    return reports;
}

// Each report cut after its line number ("Erreur ligne 3", "Attention : ligne 4"), one a line: where and
// how grave, for the reports whose wording is checked elsewhere; a report without a line stays whole.
template <class Run>
std::string ReportHeads(const Run& run) {
    std::string heads;
    for (const std::string& line : run.Reports()) {
        const std::size_t at = line.find("ligne ");
        heads += line.substr(0, at == std::string::npos ? line.size()
                                                        : line.find_first_not_of("0123456789", at + 6)) +
                 "\n";
    }
    return heads;
}

// The kinds of the sightings of `book` read with "References" at aucune, premiere and codes (the codes
// `codes`), "1002 1003 " for each: which sightings the format takes as references, and which the settings
// add.
template <class Reader, pyr::FieldBookFormat kFormat>
std::vector<std::string> KindsByMarking(const std::string& book, const char* codes) {
    std::vector<std::string> kinds;
    for (const char* marking : {"aucune", "premiere", "codes"}) {
        DriverRun<Reader, kFormat> run;
        std::string sightings;
        for (int kind :
             Kinds(run.Set(pyr::kKeyReferences, marking).Set(pyr::kKeyCodesReference, codes).Read(book)))
            if (pyr::IsSightingKind(kind)) sightings += std::to_string(kind) + ' ';
        kinds.push_back(sightings);
        EXPECT_EQ(ReportText(run), "") << marking;
    }
    return kinds;
}

// Each element as "kind name; ": the text of a comment, the word and parameters of a command.
inline std::string ElementsSummary(const pyr::CCarnet& carnet) {
    std::string lines;
    for (int i = 0; i < carnet.GetSize(); ++i) {
        const int kind = carnet.GetType(i);
        lines += std::to_string(kind) + ' ';
        if (kind == pyr::kKindComment)
            lines += carnet.As<pyr::CComment>(i)->text();
        else if (pyr::IsCommandKind(kind))
            lines += carnet.cmdAt(i) + (carnet.parAt(i).empty() ? "" : " " + carnet.parAt(i));
        else
            lines += carnet.matAt(i);
        lines += "; ";
    }
    return lines;
}

// HP, AH, AV, DI of a sighting, or X, Y, Z of a point, against values worked out independently, to 0.1 mm
// and 0.1 mgon; kUndefined where there must be none.
inline void ExpectValues(const pyr::CCarnet& carnet, int i, const std::vector<double>& expected) {
    const bool point = expected.size() == 3;
    const double actual[] = {point ? carnet.xAt(i) : carnet.hpAt(i), point ? carnet.yAt(i) : carnet.ahAt(i),
                             point ? carnet.zAt(i) : carnet.avAt(i), carnet.diAt(i)};
    for (std::size_t k = 0; k < expected.size() && k < 4; ++k) {
        if (pyr::IsUndefined(expected[k]))
            EXPECT_EQ(actual[k], pyr::kUndefined) << "value " << k << " of element " << i;
        else
            EXPECT_NEAR(actual[k], expected[k], 1e-4) << "value " << k << " of element " << i;
    }
}

// A point written by hand for the tests of the exports: its identifier, X, Y, Z (kUndefined where it has
// none) and code.
struct SurveyPoint {
    std::string mat;
    double x, y, z;
    std::string code;
};

// A GéoBase of those points, in their order.
inline pyr::CCarnet Survey(const std::vector<SurveyPoint>& points) {
    pyr::CCarnet carnet;
    for (const SurveyPoint& p : points)
        carnet.Add(std::make_unique<pyr::CPointGen>(p.mat, p.x, p.y, p.z, p.code), pyr::kKindPoint);
    return carnet;
}

// The export of the points of `carnet` through the settings file to the output, its messages on
// `frontEnd` and its lines in `txt`.
inline pyr::PointExportJob ExportJob(const pyr::CCarnet& carnet, std::string settings, std::string output,
                                     pyr::ui::FrontEnd& frontEnd, pyr::CPyrTxtWnd& txt) {
    pyr::PointExportJob job;
    job.carnet = &carnet;
    job.paramFile = std::move(settings);
    job.path = std::move(output);
    job.parent = &frontEnd;
    job.txt = &txt;
    return job;
}
