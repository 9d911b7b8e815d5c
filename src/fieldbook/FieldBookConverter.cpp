#include "fieldbook/FieldBookConverter.h"

#include "core/Files.h"
#include "core/SafeFile.h"
#include "core/Strings.h"
#include "fieldbook/FieldBookReader.h"
#include "fieldbook/FieldBookReaders.h"
#include "fieldbook/FieldBookTexts.h"
#include "fieldbook/LectCarnet.h"
#include "fieldbook/Preformat.h"
#include "fieldbook/TableCode.h"
#include "geobase/GeoBaseMessages.h"
#include "settings/LastGeoBase.h"
#include "ui/FrontEnd.h"
#include "ui/PyrTxtWnd.h"

#include <cerrno>
#include <cstdio>

namespace pyr {

namespace {

std::unique_ptr<CLectCarnet> MakeDialog(const FieldBookConverter& c) {
    if (c.format == FieldBookFormat::Quendal) return std::make_unique<CLecQuendal>(c.params, c.installDir);
    return std::make_unique<CLectCarnet>(c.format, c.params, c.installDir);
}

// Step 5: the code table of the editor's GéoBase, or without an editor the job's table of the settings;
// when no job has a table yet, the installation's default one.
void ChooseCodeTable(FieldBookConverter& c, CLectCarnet& dialog, const FieldBookFormatInfo& info) {
    if (c.document) {
        c.codeTable = c.document->codeTable;
        if (c.codeTable)
            dialog.SetCodeTablePath(c.codeTable->FileName());
        else
            c.FrontEnd().MessageBox(info.noCodeTable, ui::kCaption, ui::kIconWarning);
        return;
    }
    std::string path;
    c.params.ReadString(kSectionGeocodification, kKeyTableDeCode, "", path);
    if (const std::string installed = InstallationConfigFile(c.installDir, kDefaultCodeTable);
        path.empty() && FileExists(installed))
        path = installed;
    dialog.SetCodeTablePath(path);
    c.ownedTable = std::make_unique<CTableCode>();
    c.codeTable = c.ownedTable.get();
    if (!path.empty()) c.codeTable->Init(dialog.ResolvedCodeTable(), c.txt);
}

// Step 10: the table named in the dialog loaded and kept as the job's table, unless it is the default one
// or the person chose to go on without a table.
void KeepCodeTable(FieldBookConverter& c, const CLectCarnet& dialog) {
    if (!dialog.Interpret() || dialog.NoCodeTable() || IsDefaultCodeTable(dialog.CodeTablePath())) return;
    const std::string resolved = dialog.ResolvedCodeTable();
    if (c.codeTable && !EqualIgnoringCase(c.codeTable->FileName(), resolved))
        c.codeTable->Init(resolved, c.txt);
    c.params.WriteString(kSectionGeocodification, kKeyTableDeCode, WholePath(resolved));
}

// What the reader took from the field book: the instrument that the conversion writes at the head when
// asked is not.
int ElementsRead(const CCarnet& result, const ReadingChoices& choices) {
    const bool instrument =
        choices.writeInstrument && !result.IsEmpty() && result.GetType(0) == kKindAppareil;
    return result.GetSize() - (instrument ? 1 : 0);
}

} // namespace

FieldBookConverter::FieldBookConverter(FieldBookFormat format, ui::FrontEnd* parent, std::string paramPath,
                                       std::string installDir, CPyrTxtWnd* txt, EditorDocument* document)
    : format(format), parent(parent), params(std::move(paramPath)), document(document),
      installDir(std::move(installDir)), txt(txt) {}

FieldBookConverter::~FieldBookConverter() = default;

ui::FrontEnd& FieldBookConverter::FrontEnd() const {
    return parent ? *parent : ui::ApplicationFrontEnd();
}

bool HasZeroPrismHeight(const CCarnet& carnet) {
    for (int i = 0; i < carnet.GetSize(); ++i)
        if (IsSightingKind(carnet.GetType(i)) && carnet.hpAt(i) == 0.0) return true;
    return false;
}

int WriteNewGeoBase(const CCarnet& carnet, const std::string& path) {
    SafeFileWriter writer(path);
    if (!writer.File()) return writer.Error() != 0 ? writer.Error() : EIO;
    errno = 0;
    if (!carnet.Write(writer.File(), true)) {
        // A write refused by the system says why (a full disk, a size limit).
        const int code = errno != 0 ? errno : EIO;
        writer.Abandon();
        return code;
    }
    return writer.Commit() ? 0 : writer.Error();
}

ui::DialogResult RunConversion(FieldBookConverter& c, CCarnet* target) {
    const FieldBookFormatInfo& info = FormatInfo(c.format);
    ui::FrontEnd& frontEnd = c.FrontEnd();
    std::unique_ptr<CFieldBookReader> reader = c.makeReader ? c.makeReader() : MakeFieldBookReader(c.format);
    if (!reader) {
        frontEnd.MessageBox(Sprintf(fb::kMsgReaderMissing, info.name), ui::kCaption, ui::kIconInformation);
        return ui::DialogResult::Failed;
    }

    // 1 to 7: the dialog filled from the format's settings.
    std::unique_ptr<CLectCarnet> dialog = MakeDialog(c);
    dialog->SetFormatName(info.name);
    dialog->SetCreateNew(target == nullptr);
    dialog->SetInputs({std::string(), std::string(c.params.Path()), c.installDir, dialog->Caption()});
    const std::string_view section = info.section;
    if (dialog->HasParamFile()) {
        std::string file;
        c.params.ReadString(section, kKeyParametrage,
                            InstallationConfigFile(c.installDir, info.parameterFile), file);
        dialog->SetParamFile(file);
    }
    std::string carnet;
    c.params.ReadString(section, kKeyCarnet, "", carnet);
    dialog->SetCarnetFromSettings(carnet);
    int interpret = 0;
    c.params.ReadInt(section, kKeyInterpretation, 0, 0, 1, interpret);
    dialog->SetInterpret(interpret != 0);
    ChooseCodeTable(c, *dialog, info);
    std::string instrument;
    c.params.ReadString(section, kKeyAppareilTerrain, "", instrument);
    dialog->SetInstrumentName(instrument);
    int writeInstrument = 0, testHpNulle = 0;
    c.params.ReadInt(section, kKeyEcrireAppareil, 0, 0, 1, writeInstrument);
    dialog->SetWriteInstrument(writeInstrument != 0);
    if (info.testHpNulle) c.params.ReadInt(section, kKeyTestHpNulle, 1, 0, 1, testHpNulle);
    dialog->SetTestHpNulle(testHpNulle != 0);
    dialog->SetInstruments(c.document ? c.document->instruments : ReadInstruments(c.params.Path()));
    dialog->SetCodeTableObject(c.codeTable);

    // 8, 9: the dialog, then its values kept.
    const ui::DialogResult shown = c.showDialog ? c.showDialog(*dialog) : frontEnd.DoModal(*dialog);
    if (shown != ui::DialogResult::Ok) return shown;
    if (dialog->HasParamFile())
        c.params.WriteString(section, kKeyParametrage, WholePath(dialog->ParamFile()));
    c.params.WriteString(section, kKeyCarnet, dialog->Carnet());
    c.params.WriteInt(section, kKeyInterpretation, dialog->Interpret() ? 1 : 0);
    c.params.WriteString(section, kKeyAppareilTerrain, dialog->InstrumentName());
    c.params.WriteInt(section, kKeyEcrireAppareil, dialog->WriteInstrument() ? 1 : 0);

    // 10, 11: the code table and the parameter set.
    KeepCodeTable(c, *dialog);
    if (dialog->HasParamFile() && !dialog->Driver().Load(&frontEnd)) return ui::DialogResult::Failed;

    // 12: the reading, of the pre-formatted file when a program makes one.
    const ReadingChoices choices = dialog->Choices();
    reader->SetChoices(choices);
    reader->SetCodeTable(c.codeTable);
    reader->SetDriver(dialog->HasParamFile() ? &dialog->Driver() : nullptr);
    reader->SetTextWindow(c.txt);
    reader->SetParent(&frontEnd);
    PreformatOutcome preformatted{choices.carnet, false};
    if (info.preformatting) {
        std::string program;
        c.params.ReadString(section, kKeyPreformattage, "", program);
        preformatted = Preformat(choices.carnet, program, frontEnd);
    }
    const bool read = reader->Read(preformatted.fileToRead, c.result);
    if (preformatted.temporary) std::remove(preformatted.fileToRead.c_str());
    if (!read) return ui::DialogResult::Failed;

    // 15: the new GéoBase, written whole; recorded as the last file when it holds what was read.
    const std::string& path = dialog->GeoBasePath();
    const auto writeGeoBase = [&](const CCarnet& carnet, bool record) {
        const bool existed = FileExists(path);
        // "Replace it" is an answer about a GéoBase: a field book or any other file of that name (the
        // book itself named as the GéoBase to create) is never written over.
        if (const std::string refusal = carnet.SaveRefusal(path); !refusal.empty()) {
            frontEnd.ReportFailure(std::string(msg::kCannotWrite) + "\n<" + path + ">" + refusal);
            return false;
        }
        if (const int error = WriteNewGeoBase(carnet, path); error != 0) {
            std::string text = Sprintf(fb::kGeoBaseAndReason, msg::kCannotWrite, path.c_str(),
                                       SystemErrorText(error).c_str());
            if (existed) text += fb::kGeoBaseKept;
            frontEnd.ReportFailure(text);
            return false;
        }
        if (c.txt) c.txt->Print(msg::kCreated, path.c_str());
        c.m_written = path;
        if (!record) return true;
        const std::string recorded = WholePath(path);
        c.registry.WriteString(kSectionPyralis, kKeyDernierFichier, recorded);
        WriteLastGeoBase(c.params.Path(), recorded);
        return true;
    };

    // A field book of another format, or an empty one, gives nothing: no GéoBase that holds something is
    // replaced by an empty one, nothing is added to the editor's, and the last file stays the one the
    // surveyor worked on.
    if (ElementsRead(c.result, choices) == 0) {
        frontEnd.ReportFailure(Sprintf(fb::kMsgNothingRead, choices.carnet.c_str(), info.name));
        if (!target && !FileExists(path)) writeGeoBase(CCarnet(), false);
        return ui::DialogResult::Failed;
    }

    // 13, 14: the check of the prism heights, then the merge.
    if (dialog->TestHpNulle() && HasZeroPrismHeight(c.result))
        frontEnd.MessageBox(fb::kMsgZeroPrismHeight, ui::kCaption, ui::kIconInformation);
    if (target) {
        target->Append(std::move(c.result));
        return ui::DialogResult::Ok;
    }
    return writeGeoBase(c.result, true) ? ui::DialogResult::Ok : ui::DialogResult::Failed;
}

} // namespace pyr
