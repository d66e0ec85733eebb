#include "util/fault_log.h"

#include <array>
#include <csignal>
#include <cstdio>
#include <cstring>
#include <ctime>
#include <fcntl.h>
#include <unistd.h>

namespace {

struct FaultRow {
    int signal;
    int code;  // 0 = any other code of the signal
    const char* name;
};

constexpr std::array<FaultRow, 17> kFaults{{
    {SIGSEGV, SEGV_ACCERR, "Guard Page Violation"},
    {SIGSEGV, SEGV_BNDERR, "Array Bounds Exceeded"},
    {SIGSEGV, 0, "Access Violation"},
    {SIGBUS, BUS_ADRALN, "Data Type Misalignment"},
    {SIGBUS, 0, "In Page Error"},
    {SIGFPE, FPE_INTDIV, "Integer Divide By Zero"},
    {SIGFPE, FPE_INTOVF, "Integer Overflow"},
    {SIGFPE, FPE_FLTDIV, "Divide By Zero"},
    {SIGFPE, FPE_FLTOVF, "Float Overflow"},
    {SIGFPE, FPE_FLTUND, "Float Underflow"},
    {SIGFPE, FPE_FLTRES, "Floating Point Inexact Result"},
    {SIGFPE, FPE_FLTSUB, "Array Bounds Exceeded"},
    {SIGFPE, 0, "Invalid Operation"},
    {SIGILL, ILL_PRVOPC, "Privileged Instruction"},
    {SIGILL, 0, "Illegal Instruction"},
    {SIGTRAP, TRAP_TRACE, "Single Step"},
    {SIGTRAP, 0, "Breakpoint"},
}};
constexpr std::array kSignals{SIGSEGV, SIGBUS, SIGFPE, SIGILL, SIGTRAP};

// A handler gets no context of its own, so what it needs lies here: the one place of the program where it must.
std::array<char, 4096> logPath{};
long zoneSeconds = 0;

const FaultRow* rowOf(int signal, int code) {
    for (const FaultRow& row : kFaults) {
        if (row.signal == signal && (row.code == 0 || row.code == code)) return &row;
    }
    return nullptr;
}

void putNumber(long value, int digits, char* text) {
    for (int digit = digits - 1; digit >= 0; --digit, value /= 10)
        text[digit] = static_cast<char>('0' + value % 10);
}

// "yyyy-MM-dd hh:mm:ss:" without the library's conversions, which a handler may not call. Days to date: the civil
// calendar by Howard Hinnant's "chrono-compatible low-level date algorithms".
void putTimestamp(long now, char* text) {
    const long days = now / 86400;
    const long second = now % 86400;
    const long z = days + 719468;
    const long era = z / 146097;
    const long dayOfEra = z - era * 146097;
    const long yearOfEra = (dayOfEra - dayOfEra / 1460 + dayOfEra / 36524 - dayOfEra / 146096) / 365;
    const long dayOfYear = dayOfEra - (365 * yearOfEra + yearOfEra / 4 - yearOfEra / 100);
    const long shifted = (5 * dayOfYear + 2) / 153;
    const long day = dayOfYear - (153 * shifted + 2) / 5 + 1;
    const long month = shifted < 10 ? shifted + 3 : shifted - 9;
    const long year = yearOfEra + era * 400 + (month <= 2 ? 1 : 0);
    std::memcpy(text, "0000-00-00 00:00:00:", 20);
    putNumber(year, 4, text);
    putNumber(month, 2, text + 5);
    putNumber(day, 2, text + 8);
    putNumber(second / 3600, 2, text + 11);
    putNumber(second / 60 % 60, 2, text + 14);
    putNumber(second % 60, 2, text + 17);
}

void writeFault(int signal, siginfo_t* info, void*) {
    const FaultRow* const row = rowOf(signal, info->si_code);
    const char* const name = row ? row->name : "Unknown";
    std::array<char, 96> line{};
    putTimestamp(static_cast<long>(std::time(nullptr)) + zoneSeconds, line.data());
    std::size_t length = 20;
    for (const char* letter = name; *letter != '\0'; ++letter)
        line[length++] = *letter;
    line[length++] = '\n';
    const int file = open(logPath.data(), O_WRONLY | O_APPEND | O_CREAT, 0644);
    if (file >= 0) {
        // A log that cannot be written stays silent: there is nowhere left to report to.
        [[maybe_unused]] const ssize_t written = write(file, line.data(), length);
        close(file);
    }
    std::signal(signal, SIG_DFL);
    raise(signal);
}

}  // namespace

std::string faultName(int signal, int code) {
    if (const FaultRow* row = rowOf(signal, code)) return row->name;
    char text[32];
    std::snprintf(text, sizeof text, "Unknown (&H%08X)", static_cast<unsigned>(signal));
    return text;
}

void installFaultLog(const std::string& logFile) {
    logPath.fill('\0');
    logFile.copy(logPath.data(), logPath.size() - 1);
    const std::time_t now = std::time(nullptr);
    std::tm local{};
    localtime_r(&now, &local);
    zoneSeconds = local.tm_gmtoff;
    struct sigaction action {};
    action.sa_sigaction = writeFault;
    action.sa_flags = static_cast<int>(SA_SIGINFO | SA_RESETHAND);
    for (const int signal : kSignals)
        sigaction(signal, &action, nullptr);
}

void removeFaultLog() {
    for (const int signal : kSignals)
        std::signal(signal, SIG_DFL);
}
