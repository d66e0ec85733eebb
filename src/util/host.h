// What the core asks of whoever hosts it: message boxes, the status bar, the busy pointer, a turn of the event loop.
// The window answers with real boxes, the headless companion prints, a test records and answers from a script.
// All text is UTF-8; line breaks in it are CR LF.
#pragma once

#include <string>
#include <string_view>

inline constexpr std::string_view kProgramName = "Qen Visualizer";

enum class BoxIcon { None, Critical, Question, Warning, Information };
enum class BoxButtons { Ok, OkCancel, YesNo, YesNoCancel };
enum class BoxAnswer { Ok, Cancel, Yes, No };

class Host {
public:
    virtual ~Host() = default;

    virtual BoxAnswer messageBox(std::string_view title, std::string_view text, BoxIcon icon,
                                 BoxButtons buttons = BoxButtons::Ok) = 0;
    virtual void setStatusPanel(int panel, std::string_view text) = 0;  // panel 1..4
    virtual void setBusyPointer(bool busy) = 0;
    virtual void showCompileErrors(std::string_view text) = 0;  // the modal list of faults that keep lights dark
    // Lets waiting window events run. Never called inside a render pass, a build or a loader's walk.
    virtual void pumpEvents() = 0;
};

// The busy pointer for as long as it lives, whatever way the work ends.
class BusyPointer {
public:
    explicit BusyPointer(Host& host) : host_(host) { host_.setBusyPointer(true); }
    ~BusyPointer() { host_.setBusyPointer(false); }
    BusyPointer(const BusyPointer&) = delete;
    BusyPointer& operator=(const BusyPointer&) = delete;

private:
    Host& host_;
};

// The program's name followed directly by the suffix, as every message box is titled.
std::string boxTitle(std::string_view suffix);
