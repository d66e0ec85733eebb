#include "util/error_log.h"

#include "util/message_host.h"

#include <ctime>
#include <fstream>

namespace {

std::string localTimestamp() {
    const std::time_t now = std::time(nullptr);
    std::tm local{};
    localtime_r(&now, &local);
    char text[32] = "";
    std::strftime(text, sizeof text, "%Y-%m-%d %H:%M:%S", &local);
    return text;
}

}  // namespace

void ErrorLog::ErrReport(std::string_view description, std::string_view procedure, int line) {
    std::string message(procedure);
    message.append("-").append(std::to_string(line)).append(" (").append(description).append(")");
    ZephLogError(message);
}

void ErrorLog::note(std::string_view message) {
    std::ofstream log(file_, std::ios::app | std::ios::binary);
    log << localTimestamp() << ":" << onOneLine(message) << "\n";
}

void ErrorLog::ZephLogError(std::string_view message) {
    note(message);
    // Only the first report of a run shows, and only with the switch: the log has the rest.
    if (showNextError_) {
        showNextError_ = false;
        host_.messageBox(boxTitle("-Errors Logged"), "Errors have been logged to file:\r\n" + file_,
                         BoxIcon::Information);
    }
}
