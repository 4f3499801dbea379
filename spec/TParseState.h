#pragma once

#include "spec/TDiffXMLParser.h"

namespace NORVZEL20 {

/// What the parser has read so far, and so what it accepts next. The order of the virtual operations is part of the contract.
class TCIMDiffEngine::TDiffXMLParser::TParseState {
  public:
    virtual ~TParseState();

    /// Accepts a child element by pushing its state, or ends the parse. Here: ignores the element.
    virtual void StartElement(TDiffXMLParser& parser, std::string& name, std::map<std::string, std::string>& attrs);
    /// Ends the element on top. Here: pops this state, which may destroy it.
    virtual void EndElement(TDiffXMLParser& parser, std::string& name);
    /// Reads the attributes of the element that this state stands for. Here: ignores them.
    virtual void HandleAttrs(TDiffXMLParser& parser, std::map<std::string, std::string>& attrs);

  protected:
    /// Pushes the state of an accepted child.
    static void Push(TDiffXMLParser& parser, boost::shared_ptr<TParseState> state);
    /// Ends the parse at an element that has no place here; never returns.
    static void Unexpected(TDiffXMLParser& parser, const std::string& name);
    /// Has the state on top read its attributes.
    static void HandleAttrsOfTop(TDiffXMLParser& parser, std::map<std::string, std::string>& attrs);
    /// Ends the parse with `what`, the current line, `then` and a line end; never returns.
    static void FailOnLine(TDiffXMLParser& parser, const std::string& what, const std::string& then = std::string());
};

}  // namespace NORVZEL20
