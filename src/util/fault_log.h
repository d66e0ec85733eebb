// Faults of the hardware that no code can catch: their name reaches the log before the platform ends the process.
#pragma once

#include <string>
#include <string_view>

// The name of a fault signal by its number and code, as the log has it: "Access Violation", "Integer Divide By Zero",
// ... A signal without a name of its own gives "Unknown (&H" and its number in eight hexadecimal digits and ")".
std::string faultName(int signal, int code);

// From now on a fault appends a line with its name to the log and then goes its default way. One log a process.
// removeFaultLog gives the platform's handling back.
void installFaultLog(const std::string& logFile);
void removeFaultLog();
