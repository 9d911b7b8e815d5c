#include "fieldbook/ConfigQdl.h"

#include "core/Files.h"
#include "core/Numbers.h"
#include "core/Strings.h"
#include "fieldbook/FieldBookTexts.h"
#include "fieldbook/QuendalFormat.h"
#include "geobase/Carnet.h"
#include "ui/FrontEnd.h"

#include <cerrno>
#include <cstdio>
#include <filesystem>

namespace pyr {

namespace {

// A number as it was read, every digit kept; no value gives an empty field.
void Number(std::string& out, double value) {
    out += qdl::kSeparator;
    if (IsKnown(value)) AppendShortest(out, value);
}

void Text(std::string& out, std::string_view text) {
    out += qdl::kSeparator;
    qdl::AppendField(out, text);
}

// Drops the empty fields at the end of the record just written (from `start`), then ends its line.
void EndRecord(std::string& out, std::size_t start) {
    while (out.size() > start && out.back() == qdl::kSeparator)
        out.pop_back();
    out += '\n';
}

std::string_view Invariance(const CPointGen& point) {
    if (point.invariantXY() && point.invariantZ()) return qdl::kInvariantXYZ;
    if (point.invariantXY()) return qdl::kInvariantXY;
    if (point.invariantZ()) return qdl::kInvariantZ;
    return {};
}

void AppendRecord(std::string& out, const CElement& element, int kind) {
    const std::size_t start = out.size();
    switch (kind) {
    case kKindComment:
        out += qdl::kComment;
        Text(out, static_cast<const CComment&>(element).text());
        break;
    case kKindAppareil: {
        const auto& instrument = static_cast<const CAppareil&>(element);
        out += qdl::kInstrument;
        Text(out, instrument.mat());
        for (double value : {instrument.collVerticale(), instrument.constPrisme(), instrument.sigmaAh(),
                             instrument.sigmaAv(), instrument.sigmaDi(), instrument.sigmaPpm()})
            Number(out, value);
        break;
    }
    case kKindStation: {
        const auto& station = static_cast<const CStation&>(element);
        out += qdl::kStation;
        Text(out, station.mat());
        Number(out, station.hi());
        Number(out, station.v0());
        Text(out, station.sym());
        break;
    }
    case kKindReference:
    case kKindMesure: {
        const auto& sighting = static_cast<const CVisee&>(element);
        out += kind == kKindReference ? qdl::kReference : qdl::kMesure;
        Text(out, sighting.mat());
        for (double value : {sighting.hp(), sighting.ah(), sighting.av(), sighting.di()})
            Number(out, value);
        Text(out, sighting.sym());
        break;
    }
    case kKindLectAR:
    case kKindLectAV: {
        const auto& reading = static_cast<const CLecture&>(element);
        out += kind == kKindLectAR ? qdl::kBackReading : qdl::kForeReading;
        Text(out, reading.mat());
        Number(out, reading.lm());
        Number(out, reading.dist());
        Text(out, reading.sym());
        break;
    }
    case kKindPoint: {
        const auto& point = static_cast<const CPointGen&>(element);
        out += qdl::kPoint;
        Text(out, point.mat());
        for (double value : {point.x(), point.y(), point.z()})
            Number(out, value);
        Text(out, point.sym());
        Text(out, Invariance(point));
        break;
    }
    case kKindChemin: {
        const auto& traverse = static_cast<const CChemin&>(element);
        out += qdl::kTraverse;
        Text(out, traverse.mat());
        Text(out, traverse.isClosed() ? "1" : "0");
        for (const auto& station : traverse.stations())
            Text(out, station);
        break;
    }
    default: {
        const auto& command = static_cast<const CCommande&>(element);
        out += kind == kKindCommand ? qdl::kCode : qdl::kCommand;
        Text(out, command.word());
        Text(out, command.par());
        Text(out, command.mat());
        Text(out, command.sym());
        break;
    }
    }
    EndRecord(out, start);
}

void AppendHeader(std::string& out) {
    out += qdl::kHeader;
    out += qdl::kSeparator;
    out += std::to_string(qdl::kVersion);
    out += '\n';
}

bool Chosen(int kind, QdlExportChoices choices) {
    return kind == kKindPoint ? choices.points : choices.observations;
}

} // namespace

std::string CDlgConfigQdl::Text(const CCarnet& records, QdlExportChoices choices, bool header) {
    std::string out;
    if (header) AppendHeader(out);
    for (int i = 0; i < records.GetSize(); ++i)
        if (Chosen(records.GetType(i), choices)) AppendRecord(out, *records.GetAt(i), records.GetType(i));
    return out;
}

bool CDlgConfigQdl::Export(const PointExportJob& job, QdlExportChoices choices, int* written) {
    const CCarnet& records = *job.carnet;
    std::error_code error;
    const bool fresh = !job.append || std::filesystem::file_size(job.path, error) == 0 || error;
    const std::vector<bool> inScope = ElementsInScope(job);
    ExportFile file(job);
    std::string& out = file.Text();
    if (fresh) AppendHeader(out);
    int count = 0;
    for (int i = 0; i < records.GetSize(); ++i) {
        const int kind = records.GetType(i);
        if (!inScope[static_cast<std::size_t>(i)] || !Chosen(kind, choices)) continue;
        AppendRecord(out, *records.GetAt(i), kind);
        ++count;
        file.Flush();
    }
    if (written) *written = count;
    return file.Commit();
}

bool CDlgConfigQdl::Export(const CCarnet& records, const std::string& path, const char* mode,
                           QdlExportChoices choices, ui::FrontEnd* parent) {
    PointExportJob job;
    job.carnet = &records;
    job.path = path;
    job.append = mode && mode[0] == 'a';
    job.parent = parent;
    return Export(job, choices);
}

} // namespace pyr
