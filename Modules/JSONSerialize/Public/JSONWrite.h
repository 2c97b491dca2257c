#pragma once

#include "Modules/JSONSerialize/Public/JSONAllocator.h"
#include "Modules/JSONSerialize/Public/TextDOMTransferWriteBase.h"
#include "Runtime/Core/Containers/String.h"

#include <rapidjson/document.h>

/// Collects values in a JSON object, in the order in which they are transferred, and writes it as text.
///
/// Transfers texts (copied), int, unsigned int and unsigned long long.
class JSONWrite : public TextDOMTransferWriteBase<JSONWrite>
{
public:
    using Node = rapidjson::GenericValue<rapidjson::UTF8<>, JSONAllocator>;

    /// Starts with an empty object, which is the current node. No flag and no use of a target is defined yet:
    /// pass 0 and null.
    JSONWrite(TransferInstructionFlags flags, core::basic_string<char>* target);

    JSONWrite(const JSONWrite&) = delete;
    JSONWrite& operator=(const JSONWrite&) = delete;

    /// Returns the node that the next value is added to.
    Node& CurrentNode() { return *m_currentNode; }

    /// Replaces the contents of out by the text: compact, or pretty with four blanks a level.
    void OutputToString(core::basic_string<char>& out, bool pretty) const;

private:
    friend class TextDOMTransferWriteBase<JSONWrite>;

    Node MakeNode(const char* text) { return {text, m_allocator}; }
    Node MakeNode(int number) { return Node(number); }
    Node MakeNode(unsigned int number) { return Node(number); }
    Node MakeNode(unsigned long long number) { return Node(std::uint64_t{number}); }

    void AddToCurrentNode(const char* name, Node node);

    JSONAllocator m_allocator;
    Node m_root;
    Node* m_currentNode;
};
