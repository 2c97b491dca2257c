#pragma once

#include <rapidjson/document.h>

// The merges as the formats describe them, to compare the real ones with: every search is linear, and every
// value is copied. For documents that passed their structure check.

/// Merges search indexes.
class PlainIndexMerge
{
public:
    PlainIndexMerge();

    [[nodiscard]] const rapidjson::Value& Merged() const { return m_merged; }

    void Append(const rapidjson::Value& input, int moduleIndex);

private:
    rapidjson::Value& Push(rapidjson::Value& list, const rapidjson::Value& element);
    rapidjson::Value& PostingsOf(const rapidjson::Value& term);

    rapidjson::Document m_merged;
};

/// Merges tables of contents.
class PlainTocMerge
{
public:
    PlainTocMerge() { m_merged.SetObject(); }

    [[nodiscard]] const rapidjson::Value& Merged() const { return m_merged; }

    void Append(const rapidjson::Value& input, int moduleIndex);

private:
    void Tag(rapidjson::Value& node, int moduleIndex);
    void MergeChildren(rapidjson::Value& destination, rapidjson::Value& source);

    rapidjson::Document m_merged;
};
