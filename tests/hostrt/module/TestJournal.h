#pragma once

// What the test program and its test modules share through the host's service dictionary.

#include "hostrt/AcRx.h"

#include <string>
#include <vector>

// Put in the service dictionary by a test before it loads a module; the module writes down every
// message it receives and follows the instructions.
struct TestJournal : AcRxObject {
    std::vector<std::string> events;
    bool refuseInit = false; // answer kRetError to the initialisation
    bool stayLocked = false; // do not unlock the application
    std::string loadOnInit;  // a module to load while initialising
};

inline constexpr const char* kJournalName = "PyrTestJournal";

// The service that a test module registers under "PyrTestService <module name>".
struct TestService : AcRxObject {
    void* appId = nullptr;
};

inline TestJournal* Journal() {
    return static_cast<TestJournal*>(acrxServiceDictionary()->at(kJournalName));
}
