// SPDX-License-Identifier: Apache-2.0
// What tools/bench runs: measures, prints, writes docs/performance.md and docs/performance.svg. Ends with 1 where a
// goal is missed by more than a tenth or a part cannot be measured, with 2 where it is misused.
#include <algorithm>
#include <chrono>
#include <cstdlib>
#include <fstream>
#include <iostream>
#include <stdexcept>

#include "Paths.h"
#include "bench/Page.h"
#include "tests/support/system/TemporaryDirectory.h"

namespace Benchmark {

const std::vector<Part>& parts() {
  static const std::vector<Part> all = {{"trace-lines", measureTraceLines},
                                        {"log-lines", measureLogLines},
                                        {"candidates", measureCandidates},
                                        {"library", measureLibrary},
                                        {"requests", measureRequests},
                                        {"echo", measureEcho},
                                        {"associations", measureAssociations},
                                        {"bmc", measureBmc},
                                        {"memory", measureMemory},
                                        {"peers", measurePeers}};
  return all;
}

namespace {

struct Options {
  std::vector<std::string> only;
  bool write = true;
};

[[noreturn]] void misused(const std::string& reason) {
  std::string names;
  for (const Part& part : parts()) {
    names += ' ' + part.name;
  }
  std::cerr << "bench: " << reason << "\nusage: bench [--only NAME]... [--no-write]\nNAME is one of:" << names << '\n';
  std::exit(2);
}

Options optionsOf(const std::vector<std::string>& arguments) {
  Options options;
  for (std::size_t i = 0; i < arguments.size(); ++i) {
    if (arguments[i] == "--no-write") {
      options.write = false;
    } else if (arguments[i] == "--only") {
      if (++i == arguments.size()) {
        misused("--only needs a name");
      }
      if (std::ranges::find(parts(), arguments[i], &Part::name) == parts().end()) {
        misused("no part is called " + arguments[i]);
      }
      options.only.push_back(arguments[i]);
      // The page is of one run.
      options.write = false;
    } else {
      misused("unknown argument: " + arguments[i]);
    }
  }
  return options;
}

void write(const std::string& file, const std::string& text) {
  std::ofstream stream(file);
  stream << text;
  stream.close();
  if (!stream) {
    throw std::runtime_error(file + " cannot be written");
  }
}

// Returns whether the part could be measured.
bool measure(const Part& part, Results& results) {
  const auto begin = std::chrono::steady_clock::now();
  bool measured = true;
  std::cout << part.name << ':' << std::flush;
  try {
    part.measure(results);
  } catch (const std::exception& error) {
    measured = false;
    results.notes.push_back(part.name + ": " + error.what());
    std::cerr << "bench: " << part.name << ": " << error.what() << '\n';
  }
  const std::chrono::duration<double> seconds = std::chrono::steady_clock::now() - begin;
  std::cout << ' ' << shown(seconds.count()) << " s\n";
  for (const Row& row : rows) {
    const auto figure = results.figures.find(row.name);
    if (row.part == part.name && figure != results.figures.end()) {
      std::cout << "  " << row.what << ": " << shown(figure->second) << ' ' << row.unit;
      if (row.most) {
        std::cout << ", goal " << shown(*row.most);
      }
      std::cout << (isMissed(row, figure->second) ? ", MISSED\n" : "\n");
    }
  }
  return measured;
}

int run(const Options& options) {
  // The programs that are measured have an agent.ini of their own; this one's agent keeps no log.
  const Testing::TemporaryDirectory directory;
  ::setenv("QV_AGENT_INI",
           directory.write("agent.ini", "[log]\ndestination = off\n[trace]\ndestination = off\n").c_str(), 1);
  Results results;
  bool measured = true;
  for (const Part& part : parts()) {
    if (options.only.empty() || std::ranges::find(options.only, part.name) != options.only.end()) {
      measured = measure(part, results) && measured;
    }
  }
  for (const std::string& note : results.notes) {
    std::cout << "Not measured: " << note << '\n';
  }
  if (options.write) {
    write(SOURCE_DIR "/docs/performance.md", pageOf(results));
    write(SOURCE_DIR "/docs/performance.svg", plotOf(results));
  }
  bool missed = false;
  for (const Row& row : rows) {
    const auto figure = results.figures.find(row.name);
    if (figure != results.figures.end() && isMissed(row, figure->second)) {
      std::cerr << "bench: goal missed: " << row.what << ": " << shown(figure->second) << ' ' << row.unit << ", not "
                << shown(*row.most) << '\n';
      missed = true;
    }
  }
  return missed || !measured ? EXIT_FAILURE : EXIT_SUCCESS;
}

}  // namespace

}  // namespace Benchmark

int main(int argc, char** argv) {
  try {
    return Benchmark::run(Benchmark::optionsOf({argv + 1, argv + argc}));
  } catch (const std::exception& error) {
    std::cerr << "bench: " << error.what() << '\n';
    return EXIT_FAILURE;
  }
}
