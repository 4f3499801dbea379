#pragma once

#include "spec/TDiffXMLParser.h"

namespace NORVZEL20 {

/// A state of the parser: the element that is open, and so the child elements that are accepted next. The base class ignores child
/// elements and attributes. The order of the virtual operations is part of the contract.
class TCIMDiffEngine::TDiffXMLParser::TParseState {
  public:
    virtual ~TParseState();

    /// Pushes the state of a child element, or ends the parse if the child has no place here.
    virtual void StartElement(TDiffXMLParser& parser, std::string& name, std::map<std::string, std::string>& attrs);
    /// Ends the element: pops this state from the stack. The caller must hold a pointer to the state, which may die otherwise.
    virtual void EndElement(TDiffXMLParser& parser, std::string& name);
    /// Reads the attributes of this state's own element.
    virtual void HandleAttrs(TDiffXMLParser& parser, std::map<std::string, std::string>& attrs);

  protected:
    /// Pushes the state of an accepted child.
    static void Push(TDiffXMLParser& parser, boost::shared_ptr<TParseState> state);
    /// Ends the parse at an element that has no place here. Errors: kParseError (9), always.
    [[noreturn]] static void Unexpected(TDiffXMLParser& parser, const std::string& name);
    /// Makes the state on top, which was pushed for an accepted child, read its attributes.
    static void HandleAttrsOfTop(TDiffXMLParser& parser, std::map<std::string, std::string>& attrs);
    /// Ends the parse with a message of `what`, the current line, `then` and a line end. Errors: kParseError (9), always.
    [[noreturn]] static void FailOnLine(TDiffXMLParser& parser, const std::string& what, const std::string& then = std::string());
};

}  // namespace NORVZEL20
