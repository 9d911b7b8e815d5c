#pragma once

#include <functional>
#include <string>
#include <utility>
#include <vector>

// A dialog as a model: its state, its rules and its actions, without any widget and without any command
// line. A front end shows it and forwards a person's actions; it listens to the model's change notices to
// show again what changed.
namespace pyr::ui {

// How a modal dialog ended.
enum class DialogResult {
    Ok,     // closed with OK: the work is done
    Cancel, // closed without change
    Failed  // refused or failed; a message has said why
};

// What every command hands to its dialog before it opens (the last GéoBase, the current parameter
// file, the installation folder, the command's title).
struct CommandInputs {
    std::string geoBase;      // the GéoBase offered first: the last one used
    std::string paramPath;    // the current parameter path (a file or a registry root)
    std::string configFolder; // the installation folder, ending with a separator; holds "Config/"
    std::string title;        // "calcul d'un point par intersections de visées"
};

class DialogModel {
public:
    // A change notice: the parts of the dialog that changed, as bits the model defines.
    using Listener = std::function<void(int parts)>;

    virtual ~DialogModel() = default;

    void SetInputs(CommandInputs inputs) { m_inputs = std::move(inputs); }
    const CommandInputs& Inputs() const { return m_inputs; }

    // The GéoBase the dialog works on: the one offered first, until the person names another.
    const std::string& GeoBase() const { return m_inputs.geoBase; }
    void SetGeoBase(std::string path) {
        m_inputs.geoBase = std::move(path);
        m_geoBaseNamed = true;
    }
    // Whether the person named the GéoBase (rather than taking the one offered).
    bool GeoBaseNamed() const { return m_geoBaseNamed; }

    // The caption of the dialog's window.
    virtual std::string Caption() const { return m_inputs.title; }

    // Calls `listener` after every change of the model, with the parts changed. Returns its number.
    int Listen(Listener listener) {
        m_listeners.emplace_back(++m_lastListener, std::move(listener));
        return m_lastListener;
    }
    void StopListening(int number) {
        std::erase_if(m_listeners, [number](const auto& entry) { return entry.first == number; });
    }

protected:
    void Notify(int parts) const {
        for (const auto& [number, listener] : m_listeners)
            listener(parts);
    }

private:
    CommandInputs m_inputs;
    bool m_geoBaseNamed = false;
    std::vector<std::pair<int, Listener>> m_listeners;
    int m_lastListener = 0;
};

} // namespace pyr::ui
