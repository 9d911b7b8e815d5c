#pragma once

#include <cstdint>
#include <map>
#include <string>

namespace pyr::host {

// What the module keeps for each open drawing.
struct CArxGlobals {
    std::string lastGeoBase; // the GéoBase last worked on while this drawing was current
};

// The module's data for each open drawing, created the first time the drawing is met.
template <class Globals>
class CPyrDataMDIManager {
public:
    bool Knows(const void* document) const { return m_documents.count(document) != 0; }
    Globals& Register(const void* document) { return m_documents[document]; }
    void Forget(const void* document) { m_documents.erase(document); }
    // The data of the drawing, registered on first use.
    Globals& DocGlobals(const void* document) { return m_documents[document]; }
    std::size_t Count() const { return m_documents.size(); }

private:
    std::map<const void*, Globals> m_documents;
};

using CArxDataManager = CPyrDataMDIManager<CArxGlobals>;

// The application object of the module: one instance while the module is loaded, answering the host's
// messages.
class CPyrAppModul {
public:
    CPyrAppModul();
    CPyrAppModul(const CPyrAppModul&) = delete;
    CPyrAppModul& operator=(const CPyrAppModul&) = delete;

    // The virtual operations, in the order of their slots.
    virtual ~CPyrAppModul();
    // Answers a message of the host: 1 initialisation, 2 unloading, 3 a drawing opened, 4 a drawing
    // closed; any other is answered 0 and does nothing.
    virtual int OnMessage(int message, void* packet);
    // Loads the main services, installs the toolbar and registers the commands; non-zero on success.
    virtual int Init();
    // Removes the command group and takes leave of the services.
    virtual void Uninit();
    // A drawing was opened or closed.
    virtual void OnDocument();
    virtual void* AppId() const;

    const std::string& AppName() const { return m_appName; }
    const std::string& Configuration() const { return m_configuration; }
    CArxDataManager& DataManager() { return m_dataManager; }

private:
    std::string m_appName;
    void* m_appId = nullptr;
    std::string m_text;
    std::string m_configuration; // handed to the services when the module registers with them
    CArxDataManager m_dataManager;
};

// The one application object (null before the module is set up and after it is taken down).
CPyrAppModul* TheApp();
void SetTheApp(CPyrAppModul* app);

// What the module's exported entry point does: 3 when there is no application object, else what the
// application object answers.
int ModuleEntryPoint(int message, void* packet);

} // namespace pyr::host
