#pragma once

#include <functional>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "tests/hosts/Guide.h"
#include "tests/support/client/WbemClient.h"

namespace Testing {

// An object manager that is installed on this machine, brought from its stock state to serving the product by the
// commands of docs/object-managers.md. It is changed for good: to be used on a private machine only.
class ObjectManager : public WbemClient {
 public:
  using Edit = std::function<std::string(const std::string& commands)>;

  // The one of that name, "sfcb" or "openpegasus", as its environment variable says where it is. Returns null where the
  // variable is not set, throws std::invalid_argument for another name.
  // @param processes how many the two libraries run in: 1, as they are registered, or 2
  static std::unique_ptr<ObjectManager> find(const std::string& name, int processes);

  // The environment variable that holds the prefix of an installation.
  static std::string variableOf(const std::string& name);

  // What has to be there and is not, with what to do about it, in a line; empty if nothing is missing.
  std::string missing() const;

  const std::string& prefix() const { return prefix_; }
  std::uint16_t port() const override { return port_; }
  int processes() const { return processes_; }
  const Guide& guide() const { return guide_; }

  // From stock to serving, and back again. An edit changes the commands of every step before they are run.
  void install(const Edit& edit = {});
  void remove(const Edit& edit = {});
  // A new version over the one that is there.
  void upgrade();

  // The registration alone, by the command that the document names for it: from stopped to serving, and from running to
  // stopped.
  void registerByCommand(const Edit& edit = {});
  void takeOutByCommand();

  void start(const Edit& edit = {});
  void stop();
  void restart();
  bool isListening() const;
  // Ends it without asking it to end.
  void kill();

  // Writes agent.ini: the managed system is managed.example, the host is shown in root/yrnse, and the given sections
  // say how the management processor is reached. Takes effect with the next start of the object manager.
  void configureAgent(const std::string& processor, int logThreshold = 6000) const;
  std::string log() const;
  // Everything that an administrator is told beside the answer to a client.
  virtual std::string diagnostics() const { return log(); }
  // The file that a simulated management processor is kept in, and what it holds.
  static std::string stateFile();
  static std::string simulatedProcessor();

  // Has the object manager end the processes that have the libraries loaded, which it starts again when asked. Gives
  // false if they do not end.
  virtual bool unloadProviders() = 0;
  // Takes back what keeps it from loading them.
  virtual void allowProviders() {}

  // The processes that have one of the libraries loaded: "composite" or "underlying"; either where none is named.
  static std::vector<pid_t> providerProcesses(const std::string& library = {});

  // Runs the commands of a step of the document; throws std::runtime_error with what they wrote where they fail.
  std::string carryOut(const std::string& step, const Edit& edit = {}) const;

  // Whether it answers Associators and AssociatorNames where the client names no association class.
  virtual bool answersWithoutAClass() const = 0;

  // Whether a request ends, with an error, when the provider process that it was given to is killed.
  virtual bool answersRequestsThatItLost() const = 0;

  // The program that its step "start" starts.
  virtual std::string program() const = 0;

  // The name that it has in the document.
  virtual std::string title() const = 0;

 protected:
  explicit ObjectManager(std::string prefix, int processes);

  std::string run(const std::string& commands) const;

  // Files and directories that an installation has, below its prefix.
  virtual std::vector<std::string> parts() const = 0;
  virtual std::vector<std::string> programs() const = 0;
  virtual Environment environment() const;
  // Texts of the document that are otherwise on this machine.
  virtual std::map<std::string, std::string> differences() const;
  // Makes it listen on port() only, and takes away what another running one left.
  virtual void prepare() = 0;
  virtual std::vector<std::string> installing() const = 0;
  virtual std::vector<std::string> removing() const = 0;
  virtual std::vector<std::string> upgrading() const = 0;
  virtual std::vector<std::string> registeringByCommand() const = 0;
  virtual std::vector<std::string> takingOutByCommand() const = 0;

 private:
  void awaitListening() const;
  void awaitEnd() const;
  void registerSeparately() const;
  void carryOutAll(const std::vector<std::string>& steps, const Edit& edit);

  const std::string prefix_;
  const int processes_;
  const std::uint16_t port_;
  const Guide guide_;
  bool prepared_ = false;
};

}  // namespace Testing
