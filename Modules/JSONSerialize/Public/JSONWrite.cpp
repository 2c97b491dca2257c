#include "Modules/JSONSerialize/Public/JSONWrite.h"

#include "Runtime/Utilities/ConsoleLog.h"

#include <rapidjson/prettywriter.h>
#include <rapidjson/writer.h>

namespace
{

/// A growing buffer that the JSON library's writers write to.
class TempBufferWriter
{
public:
    using Ch = char;

    void Put(char character) { m_text += character; }
    void Flush() {}

    [[nodiscard]] const core::string& GetText() const { return m_text; }

private:
    core::string m_text;
};

template <class Writer>
core::string WriteNode(const JSONWrite::Node& node)
{
    TempBufferWriter buffer;
    Writer writer(buffer);
    node.Accept(writer);
    return buffer.GetText();
}

} // namespace

JSONWrite::JSONWrite(TransferInstructionFlags /*flags*/, core::basic_string<char>* /*target*/)
    : m_root(rapidjson::kObjectType), m_currentNode(&m_root)
{
}

void JSONWrite::OutputToString(core::basic_string<char>& out, bool pretty) const
{
    out = pretty ? WriteNode<rapidjson::PrettyWriter<TempBufferWriter>>(m_root)
                 : WriteNode<rapidjson::Writer<TempBufferWriter>>(m_root);
}

void JSONWrite::AddToCurrentNode(const char* name, Node node)
{
    if (m_currentNode->IsObject())
    {
        m_currentNode->AddMember(MakeNode(name), node, m_allocator);
    }
    else if (m_currentNode->IsArray())
    {
        m_currentNode->PushBack(node, m_allocator);
    }
    else
    {
        DebugStringToFile(
            {"Unexpected node type.", LogType::Error, "./Modules/JSONSerialize/Public/JSONWrite", 47});
    }
}
