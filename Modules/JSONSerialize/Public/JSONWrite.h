#pragma once

#include "Modules/JSONSerialize/Public/JSONAllocator.h"
#include "Runtime/Core/Containers/String.h"

#include <rapidjson/document.h>

#include <type_traits>

/// Bits that choose how a whole object is written, and how one of its values is. None is defined yet: pass 0.
using TransferInstructionFlags = unsigned int;
using TransferMetaFlags = unsigned int;

/// Takes values one by one and adds them to a tree of nodes that Derived keeps.
///
/// Derived provides MakeNode, which returns a node for a value of each type that it can hold, and
/// AddToCurrentNode, which takes ownership of such a node.
template <class Derived>
class TextDOMTransferWriteBase
{
public:
    /// Adds a copy of value to the current node: to an object as its last member, even if a member with that
    /// name exists; to an array as its last element. If the current node is neither, adds nothing and logs an
    /// error.
    template <class T>
    void Transfer(T& value, const char* name, TransferMetaFlags /*metaFlags*/)
    {
        auto& self = static_cast<Derived&>(*this);
        self.AddToCurrentNode(name, self.MakeNode(value));
    }
};

/// Collects values in a JSON object, in the order in which they are transferred, and writes it as text.
///
/// Transfers texts, which it copies, and integers.
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

    /// Replaces the contents of out by the text: compact, or pretty with an indentation of four spaces.
    void OutputToString(core::basic_string<char>& out, bool pretty) const;

private:
    friend class TextDOMTransferWriteBase<JSONWrite>;

    Node MakeNode(const char* text) { return {text, m_allocator}; }

    template <class Integer, class = std::enable_if_t<std::is_integral_v<Integer>>>
    Node MakeNode(Integer number)
    {
        using Widest = std::conditional_t<std::is_signed_v<Integer>, std::int64_t, std::uint64_t>;
        return Node(Widest{number});
    }

    void AddToCurrentNode(const char* name, Node node);

    JSONAllocator m_allocator;
    Node m_root;
    Node* m_currentNode;
};
