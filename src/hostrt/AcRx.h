#pragma once

// The host's runtime interface, as our host programs provide it: result and message codes, the objects of
// the system registry, the service dictionary and the abort. The module reaches its host only through
// the headers of this folder.

#include <functional>
#include <map>
#include <string>
#include <string_view>
#include <vector>

// Results of the editor's functions (acedGetVar, acedSetVar, acedFindFile).
enum AcadResult : int {
    RTNORM = 5100,  // done
    RTERROR = -5001 // refused or not found
};

namespace AcRx {

// The messages that the host sends to a module's entry point.
enum AppMsgCode : int {
    kNullMsg = 0,
    kInitAppMsg = 1,   // the module is loaded; the packet is its application id
    kUnloadAppMsg = 2, // the module is about to be unloaded
    kLoadDwgMsg = 3,   // a drawing is opened; the packet is the host's handle of the drawing
    kUnloadDwgMsg = 4, // a drawing is closed; same packet
};

// The version of the host's interface that modules are built for, answered by their acrxGetApiVersion.
inline constexpr int kApiVersion = 15;

// What an entry point answers.
enum AppRetCode : int {
    kRetOK = 0,
    kRetError = 3,
};

} // namespace AcRx

// The entry point that every module exports, unmangled, under the name "acrxEntryPoint".
using AcRxEntryPointFunction = int (*)(int message, void* packet);

// Whatever the registry and the service dictionary hold.
class AcRxObject {
public:
    virtual ~AcRxObject() = default;
};

// Named entries, in the order they were put. The dictionary does not own its entries: whoever puts one
// keeps it alive until removing it (a module removes its services when it is unloaded).
class AcRxDictionary : public AcRxObject {
public:
    // The entry of that name, or null.
    AcRxObject* at(std::string_view name) const;
    // Puts (or replaces) an entry; returns the one it replaced, or null.
    AcRxObject* atPut(std::string_view name, AcRxObject* entry);
    // Removes an entry; returns it, or null when there was none.
    AcRxObject* remove(std::string_view name);
    bool has(std::string_view name) const { return at(name) != nullptr; }
    std::vector<std::string> names() const;
    std::size_t numEntries() const { return m_entries.size(); }

private:
    std::vector<std::pair<std::string, AcRxObject*>> m_entries;
};

class AcRxDynamicLinker;
class AcEdCommandStack;

// The host's system registry: "DynamicLinker", "ServiceDictionary" and "ACAD_REGISTERED_COMMANDS".
AcRxDictionary* acrxSysRegistry();
// Its entries, typed.
AcRxDynamicLinker* acrxDynamicLinker();
AcRxDictionary* acrxServiceDictionary();
AcEdCommandStack* acedRegCmds();

// Whether a service of that name is in the service dictionary.
bool acrxServiceIsRegistered(std::string_view serviceName);

// Prints the message (a printf format and its arguments) on standard error and ends the host program
// with a non-zero status. A host or a test may replace the ending (SetAbortHandler); when the
// replacement returns, so does acrx_abort.
void acrx_abort(const char* format, ...) __attribute__((format(printf, 1, 2)));

namespace pyr {

// Replaces what acrx_abort does with the formatted message; an empty function restores the default
// (print on standard error, end the program with status 1).
void SetAbortHandler(std::function<void(const std::string& message)> handler);

} // namespace pyr
