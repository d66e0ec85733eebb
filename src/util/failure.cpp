#include "util/failure.h"

void throwFailure(const char* description, SourceLine where) {
    throw Failure(description, where);
}

std::string procedureName(std::string_view module, std::string_view procedure) {
    std::string name = "Zeph.";
    name.append(module).append(".").append(procedure);
    return name;
}

void reportCaughtFailure(FailureReport& failures, std::string_view module, std::string_view procedure,
                         int guardLine) noexcept {
    // A report that fails itself must not bring down the program that it reports for.
    try {
        const std::string name = procedureName(module, procedure);
        try {
            throw;
        } catch (const Failure& failure) {
            failures.ErrReport(failure.what(), name, failure.line());
        } catch (const std::exception& failure) {
            failures.ErrReport(failure.what(), name, guardLine);
        } catch (...) {
            failures.ErrReport("unknown failure", name, guardLine);
        }
    } catch (...) {
    }
}
