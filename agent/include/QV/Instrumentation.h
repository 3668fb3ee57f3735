// SPDX-License-Identifier: Apache-2.0
// The management agent's instrumentation (libqvinstrumentation): a cursor over the management processor's nodes.
//
// These declarations are a contract between separately built libraries: another set of libraries with the same symbols
// can stand in place of ours without a rebuild of the providers. Document them; do not add to them.
#pragma once

#include <string>

namespace QV {

// The kinds of node and the properties that the composite providers use. The numbers are binding.
namespace NodeLexicon {

enum NodeType {
  IpInterfaceNode = 29  // one IP interface of the management processor
};

enum Properties {
  Ipv4Address = 25,     // dotted decimal text; settable
  Ipv4SubnetMask = 26,  // dotted decimal text, contiguous; settable
  NodeName = 108        // the interface's name; read only
};

}  // namespace NodeLexicon

// A cursor over the nodes of one type. Writes made through it are sent to the management processor no later than its
// destruction, see setProperty. Every member but the destructor may throw an exception derived from std::exception
// whose text names the cause: an unreachable processor, a refused value, a damaged state.
class Instrumentation {
 public:
  Instrumentation();
  ~Instrumentation();
  Instrumentation(const Instrumentation&) = delete;
  Instrumentation& operator=(const Instrumentation&) = delete;

  // Puts the cursor on the first node of the type, or past the end if there is none.
  void selectNode(NodeLexicon::NodeType type);

  // Whether the cursor stands on a node.
  operator bool();

  // Reads a property of the current node; false if it cannot be read. Names are those that the nodes had when
  // selectNode was called, values those that they had when the first of them was asked for after that. A node whose
  // NodeName cannot be read is passed over: the call returns false and the cursor has moved to the next node.
  bool getProperty(NodeLexicon::Properties property, std::string& value);

  // Moves the cursor to the next node of the selected type.
  void operator++();

  // Writes a property of the current node; false where the node has no such settable property. A value that no
  // management processor may be given is refused with an exception before anything is sent.
  //
  // An address waits for the mask that may follow: both then are one change, made as a whole or not at all, and the
  // call that writes the mask sends it. A mask that is refused, or that cannot be sent, withdraws the address that was
  // accepted before it. An address that no mask follows is sent by the next call of operator++ or selectNode, which
  // throws where it fails, or by the destructor, which only logs: who writes an address alone does not learn from
  // setProperty whether the management processor takes it.
  bool setProperty(NodeLexicon::Properties property, std::string& value);

 private:
  struct State;
  State* state_;
};

}  // namespace QV
