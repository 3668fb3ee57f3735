// SPDX-License-Identifier: Apache-2.0
#include "bmcip/output/Drawing.h"

#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <cstdio>
#include <cstring>
#include <memory>
#include <set>
#include <stdexcept>
#include <utility>
#include <vector>

#include "bmcip/output/Text.h"

namespace Bmcip {
namespace {

// Grows a tree of one graph. A node that stands above itself is not grown again.
class Tree {
 public:
  explicit Tree(const Graph& graph) : graph_(graph) {}

  std::string grow() {
    for (std::size_t node = 0; node < graph_.nodes.size(); ++node) {
      if (graph_.nodes[node].className == "ComputerSystem") {
        text_ += nameOf(node) + '\n';
        growBelow(node, "");
      }
    }
    return std::move(text_);
  }

 private:
  struct Branch {
    std::string association;
    std::vector<std::size_t> targets;
  };

  std::string nameOf(std::size_t node) const { return harmless(graph_.nodes[node].name); }

  std::vector<Branch> branchesOf(std::size_t node) const {
    std::vector<Branch> branches;
    for (const Graph::Edge& edge : graph_.edges) {
      if (edge.source != node) {
        continue;
      }
      auto found = std::ranges::find(branches, edge.association, &Branch::association);
      if (found == branches.end()) {
        found = branches.insert(found, {edge.association, {}});
      }
      found->targets.push_back(edge.target);
    }
    return branches;
  }

  bool hasChildren(std::size_t node) const {
    return !above_.contains(node) &&
           std::ranges::any_of(graph_.edges, [node](const Graph::Edge& edge) { return edge.source == node; });
  }

  void growBelow(std::size_t node, const std::string& indentation) {
    above_.insert(node);
    const std::vector<Branch> branches = branchesOf(node);
    for (const Branch& branch : branches) {
      const bool isLast = &branch == &branches.back();
      text_ += indentation + (isLast ? "└─ " : "├─ ") + branch.association;
      if (std::ranges::none_of(branch.targets, [this](std::size_t target) { return hasChildren(target); })) {
        const char* separator = ": ";
        for (const std::size_t target : branch.targets) {
          text_ += separator + nameOf(target);
          separator = ", ";
        }
        text_ += '\n';
        continue;
      }
      text_ += '\n';
      growEach(branch.targets, indentation + (isLast ? "   " : "│  "));
    }
    above_.erase(node);
  }

  void growEach(const std::vector<std::size_t>& targets, const std::string& indentation) {
    for (const std::size_t& target : targets) {
      const bool isLast = &target == &targets.back();
      text_ += indentation + (isLast ? "└─ " : "├─ ") + nameOf(target) + '\n';
      if (hasChildren(target)) {
        growBelow(target, indentation + (isLast ? "   " : "│  "));
      }
    }
  }

  const Graph& graph_;
  std::set<std::size_t> above_;
  std::string text_;
};

std::string quoted(const std::string& text) {
  std::string result = "\"";
  for (const char letter : harmless(text)) {
    result += letter == '"' || letter == '\\' ? std::string("\\") + letter : std::string(1, letter);
  }
  return result + '"';
}

using File = std::unique_ptr<std::FILE, decltype(&std::fclose)>;

}  // namespace

std::string treeOf(const Graph& graph) { return Tree(graph).grow(); }

std::string dotOf(const Graph& graph) {
  std::string text =
      "digraph model {\n  rankdir = LR;\n  node [shape = box, style = rounded, fontname = \"sans-serif\"];\n"
      "  edge [fontname = \"sans-serif\", fontsize = 9];\n";
  for (std::size_t i = 0; i < graph.nodes.size(); ++i) {
    const std::string name = quoted(graph.nodes[i].name);
    std::string label = quoted(graph.nodes[i].className);
    label.pop_back();
    text += "  n" + std::to_string(i) + " [label = " + label + "\\n" + name.substr(1) + "];\n";
  }
  for (std::size_t i = 1; i < graph.nodes.size(); ++i) {
    if (graph.nodes[i - 1].className == graph.nodes[i].className) {
      text += "  { rank = same; n" + std::to_string(i - 1) + " -> n" + std::to_string(i) + " [style = invis]; }\n";
    }
  }
  for (const Graph::Edge& edge : graph.edges) {
    text += "  n" + std::to_string(edge.source) + " -> n" + std::to_string(edge.target) +
            " [label = " + quoted(edge.association) + "];\n";
  }
  return text + "}\n";
}

std::string svgOf(const Graph& graph) {
  const File input(std::tmpfile(), &std::fclose);
  const File output(std::tmpfile(), &std::fclose);
  if (!input || !output) {
    throw std::runtime_error(std::string("a temporary file cannot be made: ") + std::strerror(errno));
  }
  const std::string dot = dotOf(graph);
  std::fwrite(dot.data(), 1, dot.size(), input.get());
  std::rewind(input.get());
  posix_spawn_file_actions_t actions;
  posix_spawn_file_actions_init(&actions);
  posix_spawn_file_actions_adddup2(&actions, fileno(input.get()), STDIN_FILENO);
  posix_spawn_file_actions_adddup2(&actions, fileno(output.get()), STDOUT_FILENO);
  std::string program = "dot";
  std::string option = "-Tsvg";
  char* const arguments[] = {program.data(), option.data(), nullptr};
  pid_t process = 0;
  const int failure = posix_spawnp(&process, "dot", &actions, nullptr, arguments, environ);
  posix_spawn_file_actions_destroy(&actions);
  int status = 0;
  if (failure != 0 || waitpid(process, &status, 0) != process || !WIFEXITED(status) || WEXITSTATUS(status) != 0) {
    throw std::runtime_error("the picture cannot be drawn: the program dot " +
                             std::string(failure != 0 ? std::strerror(failure) : "failed") +
                             "; install Debian's package graphviz");
  }
  std::string svg;
  std::rewind(output.get());
  std::array<char, 4096> buffer{};
  for (std::size_t size = 1; size > 0;) {
    size = std::fread(buffer.data(), 1, buffer.size(), output.get());
    svg.append(buffer.data(), size);
  }
  return svg;
}

}  // namespace Bmcip
