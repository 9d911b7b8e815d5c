#include "editor/GeoEditor.h"

#include "calc/ChangeRepTexts.h"
#include "core/Files.h"
#include "core/Strings.h"
#include "core/TextEncoding.h"
#include "editor/DuplicatePoints.h"
#include "fieldbook/ExportTexts.h"
#include "fieldbook/FieldBookConverter.h"
#include "fieldbook/FieldBookTexts.h"
#include "fieldbook/TableCode.h"
#include "geobase/Carnet.h"
#include "geobase/GeoBaseMessages.h"
#include "geobase/GeoFile.h"
#include "geobase/Selection.h"
#include "settings/CalcOptions.h"
#include "settings/LastGeoBase.h"
#include "settings/ParamStore.h"
#include "ui/FrontEnd.h"
#include "ui/PyrTxtWnd.h"

namespace pyr {

namespace {

constexpr const char* kChooseTitle = "Sélectionnez la GéoBase à éditer :";
constexpr int kKindColumn = 14;
constexpr const char* kReadingDone = "GéoBase <%s> : %d élément(s), dont %d lu(s) dans le carnet.";
constexpr const char* kSaveAsTitle = "Enregistrer la GéoBase sous :";
constexpr const char* kLabelField = "Modification du champ %s de l'élément # %d";
constexpr const char* kLabelRenumber = "Renumérotation de %d point(s)";
constexpr const char* kLabelRename = "Changement de nom de la station %s en %s";
constexpr const char* kUnnumbered = "Le point <%s> n'a pas de numéro : il garde son matricule.";
constexpr const char* kRenumbered = "%d point(s) renuméroté(s).";
constexpr const char* kRenamed = "Station <%s> renommée <%s> : %d élément(s) modifié(s).";
constexpr const char* kNoPointRemoved = "Aucun point de la sélection dans la GéoBase.";
constexpr const char* kLabelProjection = "Changement de projection de %s en %s";
constexpr const char* kProjected = "%d point(s) convertis de %s en %s.";
constexpr const char* kLabelDuplicates = "Codage des points doubles en %s";
constexpr const char* kDuplicatesCoded = "%d point(s) double(s) codé(s) %s.";
constexpr const char* kPointsRemoved = "%d point(s) supprimé(s) ; les visées sur ces points sont gardées.";

// The code table the editor holds for a GéoBase: the one it goes with, else the job's table of the
// settings; none when neither can be read.
std::unique_ptr<CTableCode> EditorCodeTable(const CCarnet& carnet, std::string_view paramPath,
                                            CPyrTxtWnd& txt) {
    std::string path = carnet.Configuration();
    if (path.empty()) ReadParamString(paramPath, kSectionGeocodification, kKeyTableDeCode, "", path);
    if (path.empty() || !FileExists(path)) return nullptr;
    auto table = std::make_unique<CTableCode>();
    if (!table->Init(path, &txt)) return nullptr;
    return table;
}

} // namespace

namespace {

// The element's fields as the file writes them, the kind code left out, two blanks between them.
std::string ElementValues(const CCarnet& carnet, int index) {
    const std::string fields = ElementLine(*carnet.GetAt(index), carnet.GetType(index));
    const size_t first = fields.find('\t');
    std::string values;
    if (first == std::string::npos) return values;
    for (char c : std::string_view(fields).substr(first + 1))
        values += c == '\t' ? std::string("  ") : std::string(1, c);
    return values;
}

} // namespace

std::string EditorLine(const CCarnet& carnet, int index) {
    return Sprintf("%06d  %s%s", index + 1, PadRight(KindLabel(carnet.GetType(index)), kKindColumn).c_str(),
                   ElementValues(carnet, index).c_str());
}

std::string EditorRow(const CCarnet& carnet, int index) {
    return Sprintf("%06d\t%s\t%s", index + 1, std::string(KindLabel(carnet.GetType(index))).c_str(),
                   ElementValues(carnet, index).c_str());
}

CGeoEditor::CGeoEditor() = default;

CGeoEditor::~CGeoEditor() {
    for (std::size_t rank = 0; rank < m_documents.size(); ++rank)
        m_documents[rank]->StopListening(m_listeners[rank]);
}

// ---------------------------------------------------------------- the GéoBases open

CGeoDocument& CGeoEditor::Document() {
    return m_current < 0 ? m_none : *m_documents[static_cast<std::size_t>(m_current)];
}

const CGeoDocument& CGeoEditor::Document() const {
    return m_current < 0 ? m_none : *m_documents[static_cast<std::size_t>(m_current)];
}

CGeoDocument& CGeoEditor::Adopt(std::unique_ptr<CGeoDocument> document) {
    // The current document's notices are the editor's; the others' wait until they are current.
    CGeoDocument* held = document.get();
    m_listeners.push_back(held->Listen([this, held](int parts) {
        if (&Document() == held) Notify(parts);
    }));
    m_documents.push_back(std::move(document));
    m_current = DocumentCount() - 1;
    Notify(kPartGeoBase | kPartSelection | kPartHistory | kPartFile | kPartDocuments);
    return *held;
}

void CGeoEditor::SetCurrentDocument(int rank) {
    if (rank < 0 || rank >= DocumentCount() || rank == m_current) return;
    m_current = rank;
    Notify(kPartGeoBase | kPartSelection | kPartHistory | kPartFile | kPartDocuments);
}

bool CGeoEditor::CloseCurrent(ui::FrontEnd& frontEnd) {
    if (m_current < 0) return true;
    if (!Document().CanClose(frontEnd)) return false;
    const auto at = static_cast<std::size_t>(m_current);
    m_documents[at]->StopListening(m_listeners[at]);
    m_documents.erase(m_documents.begin() + m_current);
    m_listeners.erase(m_listeners.begin() + m_current);
    m_current = std::min(m_current, DocumentCount() - 1);
    Notify(kPartGeoBase | kPartSelection | kPartHistory | kPartFile | kPartDocuments);
    return true;
}

bool CGeoEditor::CanCloseAll(ui::FrontEnd& frontEnd) {
    for (const auto& document : m_documents)
        if (!document->CanClose(frontEnd)) return false;
    return true;
}

std::optional<std::string> CGeoEditor::ChosenGeoBase(ui::FrontEnd& frontEnd) const {
    std::string path = GeoBase();
    if (!GeoBaseNamed()) {
        auto chosen = frontEnd.ChooseFile({false, kChooseTitle, kGeoFileFilter, kGeoFileExtension, path});
        if (!chosen) return std::nullopt;
        path = *chosen;
    }
    if (path.empty()) return std::nullopt;
    return path;
}

bool CGeoEditor::Load(const std::string& path, ui::FrontEnd& frontEnd) {
    auto document = std::make_unique<CGeoDocument>();
    if (!document->Open(frontEnd, path)) return false;
    // The next command opens the last GéoBase: never a file that is not one.
    if (!document->Carnet().LoadedFileIsForeign()) WriteLastGeoBase(Inputs().paramPath, WholePath(path));
    // A GéoBase open already is read again in its place: one window per file.
    const std::string whole = WholePath(path);
    for (int rank = 0; rank < DocumentCount(); ++rank)
        if (WholePath(DocumentAt(rank).Path()) == whole) {
            m_current = rank;
            CloseCurrent(frontEnd); // read again from its file on purpose: nothing to ask
            break;
        }
    Adopt(std::move(document));
    return true;
}

ui::DialogResult CGeoEditor::OpenGeoBase(ui::FrontEnd& frontEnd) {
    const std::optional<std::string> path = ChosenGeoBase(frontEnd);
    if (!path) return ui::DialogResult::Cancel;
    return Load(*path, frontEnd) ? ui::DialogResult::Ok : ui::DialogResult::Failed;
}

ui::DialogResult CGeoEditor::OpenAnother(ui::FrontEnd& frontEnd) {
    auto chosen = frontEnd.ChooseFile({false, kChooseTitle, kGeoFileFilter, kGeoFileExtension,
                                       Document().Path().empty() ? GeoBase() : Document().Path()});
    if (!chosen || chosen->empty()) return ui::DialogResult::Cancel;
    const std::string whole = WholePath(*chosen);
    for (int rank = 0; rank < DocumentCount(); ++rank)
        if (WholePath(DocumentAt(rank).Path()) == whole) {
            SetCurrentDocument(rank); // its edits are kept: it is not read again
            return ui::DialogResult::Ok;
        }
    return Load(*chosen, frontEnd) ? ui::DialogResult::Ok : ui::DialogResult::Failed;
}

bool CGeoEditor::Save(ui::FrontEnd& frontEnd) {
    if (m_current < 0) return false;
    if (!Document().Store().BackUp(&frontEnd) || !Document().Save(frontEnd)) return false;
    CPyrTxtWnd txt(frontEnd);
    txt.Print(msg::kSaved, Document().Path().c_str());
    return true;
}

bool CGeoEditor::SaveAs(ui::FrontEnd& frontEnd) {
    if (m_current < 0) return false;
    auto chosen =
        frontEnd.ChooseFile({true, kSaveAsTitle, kGeoFileFilter, kGeoFileExtension, Document().Path()});
    if (!chosen || chosen->empty()) return false;
    if (!Document().SaveAs(frontEnd, *chosen)) return false;
    WriteLastGeoBase(Inputs().paramPath, WholePath(*chosen));
    CPyrTxtWnd txt(frontEnd);
    txt.Print(msg::kSaved, chosen->c_str());
    return true;
}

// ---------------------------------------------------------------- edits

bool CGeoEditor::SetField(ui::FrontEnd& frontEnd, int index, FieldKey key, std::string_view text) {
    FieldChange change = SetFieldFromText(Carnet(), index, key, text);
    if (!change) {
        frontEnd.MessageBox(change.error, ui::kCaption, ui::kIconWarning);
        return false;
    }
    const FieldInfo* field = FindField(Carnet().GetType(index), key);
    ElementReplacements replacement;
    replacement.push_back({index, std::move(change.element)});
    return Document().Replace(Sprintf(kLabelField, field ? std::string(field->label).c_str() : "", index + 1),
                              std::move(replacement));
}

bool CGeoEditor::InsertComment(int index, std::string text) {
    if (!Document().Insert(index, std::make_unique<CComment>(std::move(text)), kKindComment)) return false;
    Document().Select({std::min(index, Carnet().GetSize() - 1)});
    return true;
}

bool CGeoEditor::RemoveSelected() {
    return Document().Remove(Document().Selection());
}

bool CGeoEditor::MoveSelected(int by) {
    const std::vector<int>& selection = Document().Selection();
    if (selection.size() != 1) return false;
    const int from = selection.front();
    if (!Document().Move(from, from + by)) return false;
    Document().Select({from + by});
    return true;
}

bool CGeoEditor::ToggleSelected(ui::FrontEnd& frontEnd) {
    const std::vector<int>& selection = Document().Selection();
    if (selection.size() != 1) return false;
    const int index = selection.front();
    const bool done = Carnet().GetType(index) == kKindComment ? Document().Enable(frontEnd, index)
                                                              : Document().Disable(frontEnd, index);
    if (done) Document().Select({index});
    return done;
}

namespace {

// The refusals of a renumbering in the text window, the first of them in a message.
void SayRefusals(ui::FrontEnd& frontEnd, const RenumberResult& result) {
    CPyrTxtWnd txt(frontEnd);
    for (const std::string& refusal : result.refusals)
        txt.PrintText(refusal);
    frontEnd.MessageBox(result.refusals.front(), ui::kCaption, ui::kIconWarning);
}

} // namespace

bool CGeoEditor::Renumber(ui::FrontEnd& frontEnd, const RenumberRequest& request) {
    RenumberResult result = RenumberPoints(Carnet(), request);
    if (result.Refused()) {
        SayRefusals(frontEnd, result);
        return false;
    }
    CPyrTxtWnd txt(frontEnd);
    const int count = static_cast<int>(result.renamed.size());
    for (const std::string& name : result.unnumbered)
        txt.Print(kUnnumbered, name.c_str());
    if (!Document().Replace(Sprintf(kLabelRenumber, count), std::move(result.replacements))) return false;
    txt.Print(kRenumbered, count);
    return true;
}

bool CGeoEditor::RenameStation(ui::FrontEnd& frontEnd, std::string_view oldName, std::string_view newName) {
    RenumberResult result = pyr::RenameStation(Carnet(), oldName, newName);
    if (result.Refused()) {
        SayRefusals(frontEnd, result);
        return false;
    }
    const std::string to = result.renamed.empty() ? std::string(newName) : result.renamed.front().to;
    const int elements = static_cast<int>(result.replacements.size());
    if (!Document().Replace(Sprintf(kLabelRename, std::string(oldName).c_str(), to.c_str()),
                            std::move(result.replacements)))
        return false;
    CPyrTxtWnd txt(frontEnd);
    txt.Print(kRenamed, std::string(oldName).c_str(), to.c_str(), elements);
    return true;
}

bool CGeoEditor::RemovePoints(ui::FrontEnd& frontEnd, const std::string& selection) {
    std::string why;
    const std::optional<CSelection> designated = CSelection::Parse(selection, &why);
    if (!designated) {
        frontEnd.MessageBox(Sprintf("%s\n%s", msg::kNoSelection, why.c_str()), ui::kCaption,
                            ui::kIconWarning);
        return false;
    }
    std::vector<int> points;
    for (int index = Carnet().Find(kKindPoint, ""); index >= 0;
         index = Carnet().Find(kKindPoint, "", index + 1))
        if (designated->Contains(Carnet().GetAt(index)->mat())) points.push_back(index);
    CPyrTxtWnd txt(frontEnd);
    if (points.empty()) {
        txt.Print("%s", kNoPointRemoved);
        return false;
    }
    if (!Document().Remove(points)) return false;
    txt.Print(kPointsRemoved, static_cast<int>(points.size()));
    return true;
}

// ---------------------------------------------------------------- search

int CGeoEditor::SearchAll(ui::FrontEnd& frontEnd, const SearchCriteria& criteria) {
    const std::string error = SearchCriteriaError(criteria);
    if (!error.empty()) {
        frontEnd.MessageBox(error, ui::kCaption, ui::kIconWarning);
        return -1;
    }
    std::vector<int> found = Search(Carnet(), criteria);
    const int count = static_cast<int>(found.size());
    Document().Select(std::move(found));
    return count;
}

int CGeoEditor::SearchNext(ui::FrontEnd& frontEnd, const SearchCriteria& criteria, bool forward) {
    const std::string error = SearchCriteriaError(criteria);
    if (!error.empty()) {
        frontEnd.MessageBox(error, ui::kCaption, ui::kIconWarning);
        return -1;
    }
    const std::vector<int>& selection = Document().Selection();
    const int from = selection.empty() ? (forward ? -1 : Carnet().GetSize())
                                       : (forward ? selection.back() : selection.front());
    const int next = FindNext(Carnet(), criteria, from, forward);
    if (next < 0) return 0;
    Document().Select({next});
    return 1;
}

// ---------------------------------------------------------------- duplicate points

int CGeoEditor::FindDuplicates(ui::FrontEnd& frontEnd, bool askListing, const std::string& listing) {
    if (m_current < 0) return -1;
    const std::string paramPath = Inputs().paramPath;
    std::string text;
    ReadParamString(paramPath, kSectionEditor, "TolerancePointDouble", "0.05", text);
    double tolerance = 0.0;
    if (!ParseTypedNumber(Trimmed(text), tolerance) || !IsValidDuplicateTolerance(tolerance)) {
        frontEnd.MessageBox(msg::kDuplicateToleranceRefused, ui::kCaption, ui::kIconWarning);
        return -1;
    }
    const DuplicatePoints found = FindDuplicatePoints(Carnet(), tolerance);
    CPyrTxtWnd txt(frontEnd);
    txt.PrintText(DuplicatePointsSummary(found));
    std::vector<int> points;
    points.reserve(2 * (found.pairs.size() + found.conflicts.size()));
    for (const auto* list : {&found.pairs, &found.conflicts})
        for (const DuplicatePair& pair : *list)
            points.insert(points.end(), {pair.first, pair.second});

    std::string code;
    ReadParamString(paramPath, kSectionEditor, "CodePointDouble", "", code);
    ElementReplacements coded = CodeDuplicates(Carnet(), found, code);
    if (!coded.empty()) {
        const int count = static_cast<int>(coded.size());
        Document().Replace(Sprintf(kLabelDuplicates, code.c_str()), std::move(coded));
        txt.Print(kDuplicatesCoded, count, code.c_str());
    }
    Document().Select(std::move(points));

    if (!found.pairs.empty() || !found.conflicts.empty()) {
        ListingRequest request = DuplicatePointsListing(paramPath, Carnet(), found);
        request.ask = askListing && listing.empty();
        request.path = listing;
        if (askListing || !listing.empty()) WriteComputationListing(frontEnd, request);
    }
    return static_cast<int>(found.pairs.size());
}

// ---------------------------------------------------------------- the dialogs of the menus

std::string CGeoEditor::JobProjection() const {
    std::string projection;
    ReadParamString(Inputs().paramPath, kSectionCorrections, "Projection", "Aucune", projection);
    return projection;
}

bool CGeoEditor::ChangeProjection(ui::FrontEnd& frontEnd, const std::string& to, std::string from) {
    if (m_current < 0) return false;
    if (from.empty()) from = JobProjection();
    CCarnet& carnet = Document().Store();
    // The points as they are, for the undo: the conversion changes their planimetry in place.
    ElementChanges before{LargeBlocks()};
    for (int index = carnet.Find(kKindPoint, ""); index >= 0; index = carnet.Find(kKindPoint, "", index + 1))
        if (carnet.hasXY(index)) before.push_back({index, carnet.copyElement(index)});
    if (!carnet.Projection(from, to, &frontEnd)) return false;
    const int count = static_cast<int>(before.size());
    Document().RecordChanges(Sprintf(kLabelProjection, from.c_str(), to.c_str()), std::move(before));
    CPyrTxtWnd txt(frontEnd);
    txt.Print(kProjected, count, from.c_str(), to.c_str());
    return SaveAfterDialog(txt, frontEnd);
}

bool CGeoEditor::SaveAfterDialog(CPyrTxtWnd& txt, ui::FrontEnd& frontEnd) {
    const std::string path = Carnet().PathName();
    if (!Document().Store().BackUp(&frontEnd) || !Document().SaveAs(frontEnd, path)) return false;
    txt.Print(msg::kSaved, path.c_str());
    return true;
}

ui::DialogResult CGeoEditor::ExportPoints(ui::FrontEnd& frontEnd, bool asWindow) {
    CCarnet& carnet = Document().Store();
    m_exporter.SetInputs({carnet.PathName(), Inputs().paramPath, Inputs().configFolder, exp::kCaption});
    m_exporter.SetCarnet(&carnet);
    ui::DialogResult result = ui::DialogResult::Failed;
    if (asWindow) {
        result = frontEnd.DoModal(m_exporter);
    } else {
        // The editor's selection is the one its other actions take.
        ExportRequests requests = m_exportRequests;
        if (const std::optional<std::string>& selection = m_frameChange.SelectionText()) {
            requests.selection = *selection;
            if (!requests.from) requests.scope = CDlgExportPoints::kSelected;
        }
        m_exporter.Export().SetInputs(m_exporter.Inputs());
        result = RunExport(m_exporter.Export(), requests, frontEnd, &carnet);
    }
    m_exporter.SetCarnet(nullptr);
    return result;
}

ui::DialogResult CGeoEditor::ExportPoints(ui::FrontEnd& frontEnd) {
    return ExportPoints(frontEnd, true);
}

ui::DialogResult CGeoEditor::ReadFieldBook(const Reading& reading, CPyrTxtWnd& txt, ui::FrontEnd& frontEnd,
                                           bool asWindow) {
    auto fresh = std::make_unique<CGeoDocument>();
    CCarnet* target = &Document().Store();
    if (m_current >= 0 && !Carnet().IsEmpty()) {
        const ui::Answer answer =
            frontEnd.Ask(fb::kAskAppendToGeoBase, ui::kCaption, ui::Buttons::YesNoCancel, ui::Answer::Cancel);
        if (answer == ui::Answer::Cancel) return ui::DialogResult::Cancel;
        if (answer == ui::Answer::No) target = &fresh->Store(); // the open GéoBase stays as it is
    }
    if (m_current < 0) target = &fresh->Store();
    // A new GéoBase is named after the field book: asked about at once when a command line names the book,
    // once the reading dialog has it otherwise.
    const auto nameFresh = [&frontEnd, &fresh](const std::string& carnet) {
        const std::string path = BesideCarnet(carnet, kGeoFileExtension);
        if (FileExists(path) &&
            frontEnd.Ask(Sprintf(fb::kAskReplaceGeoBase, fb::kGeoBaseExists, fb::kReplaceIt), ui::kCaption,
                         ui::Buttons::YesNo, ui::Answer::No) != ui::Answer::Yes)
            return false;
        fresh->Store().SetPathName(path);
        return true;
    };
    const bool intoFresh = target == &fresh->Store();
    if (intoFresh && fresh->Carnet().PathName().empty() && reading.carnet && !nameFresh(*reading.carnet))
        return ui::DialogResult::Cancel;

    const std::string paramPath = Inputs().paramPath;
    std::unique_ptr<CTableCode> table = EditorCodeTable(*target, paramPath, txt);
    EditorDocument document{table.get(), ReadInstruments(paramPath)};
    FieldBookConverter converter(reading.format, &frontEnd, paramPath, Inputs().configFolder, &txt,
                                 &document);
    ReadingRequests requests = m_readingRequests;
    requests.carnet = reading.carnet;
    converter.showDialog = [&](CLectCarnet& dialog) {
        dialog.SetRequests(requests);
        const ui::DialogResult shown = asWindow ? frontEnd.DoModal(dialog) : dialog.Run(frontEnd);
        if (shown == ui::DialogResult::Ok && intoFresh && fresh->Carnet().PathName().empty() &&
            !nameFresh(dialog.Carnet()))
            return ui::DialogResult::Cancel;
        return shown;
    };
    const int former = target->GetSize();
    const ui::DialogResult read = RunConversion(converter, target);
    if (read != ui::DialogResult::Ok) return read;

    // A million elements read are not kept one by one in the history: the reading is saved at once,
    // and the edits before it can no longer be taken back.
    if (intoFresh)
        Adopt(std::move(fresh));
    else
        Document().ForgetHistory();
    if (!SaveAfterDialog(txt, frontEnd)) return ui::DialogResult::Failed;
    const std::string path = Carnet().PathName();
    WriteLastGeoBase(paramPath, WholePath(path));
    // The view refreshed from the former end of the GéoBase on.
    txt.Print(kReadingDone, path.c_str(), Carnet().GetSize(), Carnet().GetSize() - former);
    if (!asWindow) // a window lists them
        for (int i = former; i < Carnet().GetSize(); ++i)
            txt.PrintText(EditorLine(Carnet(), i));
    // The options may ask for the duplicate points after every reading: a point surveyed again under
    // another name is best seen while the field is fresh.
    int lookForDuplicates = 0;
    ReadParamInt(paramPath, kSectionEditor, "PointsDoubles", 0, 0, 1, lookForDuplicates);
    if (lookForDuplicates == 1 && FindDuplicates(frontEnd, asWindow) > 0 && Document().Modified() &&
        !SaveAfterDialog(txt, frontEnd))
        return ui::DialogResult::Failed;
    return ui::DialogResult::Ok;
}

ui::DialogResult CGeoEditor::ReadFieldBook(ui::FrontEnd& frontEnd, FieldBookFormat format) {
    CPyrTxtWnd txt(frontEnd);
    return ReadFieldBook(Reading{format, std::nullopt}, txt, frontEnd, true);
}

bool CGeoEditor::ReduceStations(CPyrTxtWnd& txt, ui::FrontEnd& frontEnd, bool asWindow) {
    CCarnet& carnet = Document().Store();
    m_reduction.SetInputs({carnet.PathName(), Inputs().paramPath, Inputs().configFolder, kReductionCaption});
    CReduction_Station& reduction = m_reduction.Reduction();
    reduction.SetCarnet(&carnet);
    const ui::DialogResult shown = asWindow ? frontEnd.DoModal(m_reduction) : m_reduction.Run(frontEnd);
    reduction.SetCarnet(nullptr);
    if (shown != ui::DialogResult::Ok || !reduction.Changed()) {
        txt.Print("%s", msg::kNoChange);
        return true;
    }
    // The reduction rewrites the set-ups and their sightings in place: it is not undone.
    Document().ForgetHistory();
    return SaveAfterDialog(txt, frontEnd);
}

bool CGeoEditor::ReduceStations(ui::FrontEnd& frontEnd) {
    CPyrTxtWnd txt(frontEnd);
    return ReduceStations(txt, frontEnd, true);
}

ui::DialogResult CGeoEditor::ChangeFrame(CPyrTxtWnd& txt, ui::FrontEnd& frontEnd, bool asWindow) {
    CCarnet& carnet = Document().Store();
    m_frameChange.SetInputs({carnet.PathName(), Inputs().paramPath, Inputs().configFolder, rep::kCaption});
    CChange_Rep& change = m_frameChange.FrameChange();
    change.SetCarnet(&carnet);
    const ui::DialogResult shown = asWindow ? frontEnd.DoModal(m_frameChange) : m_frameChange.Run(frontEnd);
    change.SetCarnet(nullptr);
    if (shown == ui::DialogResult::Failed) return shown;
    if (shown != ui::DialogResult::Ok || !change.Changed()) {
        txt.Print("%s", msg::kNoChange);
        return shown;
    }
    // Every element it rewrote, with its former state: one edit that the undo takes back.
    Document().RecordChanges(rep::kCaption, std::move(change.Changes()));
    change.Changes().clear();
    if (!SaveAfterDialog(txt, frontEnd)) return ui::DialogResult::Failed;
    return ui::DialogResult::Ok;
}

ui::DialogResult CGeoEditor::ChangeFrame(ui::FrontEnd& frontEnd) {
    CPyrTxtWnd txt(frontEnd);
    return ChangeFrame(txt, frontEnd, true);
}

} // namespace pyr
