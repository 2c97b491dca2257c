#pragma once

/// Bits that choose how a whole object is written, and how one of its values is. None is defined yet: pass 0.
using TransferInstructionFlags = unsigned int;
using TransferMetaFlags = unsigned int;

/// Takes values one by one and adds them to a tree of nodes that Derived keeps.
///
/// Derived provides MakeNode, which returns a node for a value of each type that it can hold, and
/// AddToCurrentNode, which takes such a node over.
template <class Derived>
class TextDOMTransferWriteBase
{
public:
    /// Adds a copy of value to the current node: to an object as its last member, without a look at members
    /// that may have the same name; to an array as its last element. If the current node is neither, nothing
    /// is added and an error is logged.
    template <class T>
    void Transfer(T& value, const char* name, TransferMetaFlags /*metaFlags*/)
    {
        auto& self = static_cast<Derived&>(*this);
        self.AddToCurrentNode(name, self.MakeNode(value));
    }
};
