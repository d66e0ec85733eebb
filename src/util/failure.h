// Failures: thrown inside, caught once by the guard of the procedure that an event or a program called, reported
// through ErrReport, and turned into that procedure's failure result.
#pragma once

#include <stdexcept>
#include <string>
#include <string_view>

// The line of whoever calls a procedure that takes this with current() as its default. The standard's own
// source_location is not there yet in the compiler of the sanitizers.
struct SourceLine {
    int number = 0;
    static constexpr SourceLine current(int line = __builtin_LINE()) noexcept { return {line}; }
};

// An exception that remembers the line on which it arose.
class Failure : public std::runtime_error {
public:
    explicit Failure(const std::string& description, SourceLine where = SourceLine::current())
        : std::runtime_error(description), line_(where.number) {}
    int line() const noexcept { return line_; }

private:
    int line_;
};

[[noreturn]] void throwFailure(const char* description, SourceLine where);

// Throws Failure with the caller's line unless the condition holds.
inline void require(bool condition, const char* description, SourceLine where = SourceLine::current()) {
    if (!condition) [[unlikely]]
        throwFailure(description, where);
}

// Takes every report of a failure. The program's writes to the log, a test's collects.
class FailureReport {
public:
    virtual ~FailureReport() = default;
    // procedure: project, module and procedure, joined by points. line: where the failure arose, 0 = not known.
    virtual void ErrReport(std::string_view description, std::string_view procedure, int line) = 0;
};

// The name under which a procedure reports: "Zeph", module and procedure, joined by points.
std::string procedureName(std::string_view module, std::string_view procedure);

// Reports the exception in flight; to be called inside a catch only. guardLine stands in where it carries no line.
void reportCaughtFailure(FailureReport& failures, std::string_view module, std::string_view procedure,
                         int guardLine) noexcept;

// Closes a function-try-block: reports the failure under the procedure's own name and gives the failure result.
#define ZEPH_GUARD(failures, module, result)                                                                           \
    catch (...) {                                                                                                      \
        reportCaughtFailure((failures), (module), __func__, __LINE__);                                                 \
        return result;                                                                                                 \
    }
