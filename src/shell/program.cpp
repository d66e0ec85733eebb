#include "shell/program.h"

#include "model/data_directories.h"

namespace {

constexpr int kSystemFolder = 7;

}  // namespace

std::string logFileOf(const ZephPathService& paths) {
    return ZephReturnDataDirectory(kSystemFolder, paths, ZephSettings{}) + "errorlog.txt";
}

Program::Program(ProgramSeams given, CommandLineParms commandLine)
    : seams(std::move(given)), parms(std::move(commandLine)), paths(seams.dataFolder),
      failures(logFileOf(paths), parms.ShowNextError, seams.host), random(seams.seed), sink(tables, seams.clock) {}
