#include "dpxlsx/readers/xlsx/plain_shared_strings.h"

#include <cstddef>
#include <cstring>
#include <string_view>

#include "dpxlsx/readers/xlsx/shared_string_entries.h"
#include "dpxlsx/readers/xml/plain_xml.h"

namespace dp {

namespace {

class PlainSharedStrings {
  public:
    PlainSharedStrings(PlainXml& xml, SharedStringEntries& entries)
        : xml_(xml), entries_(entries) {}

    // False when the part is not plain.
    bool run() {
        readTable();
        // What follows says nothing, but libxml2 reads ahead and fails when it is damaged.
        while (node_ != Node::Finished && node_ != Node::NotPlain) node_ = xml_.next();
        return node_ == Node::Finished;
    }

  private:
    using Node = PlainXml::Node;

    void readTable() {
        node_ = xml_.next();
        while (!isElement() || xml_.name() != "sst") {
            if (node_ == Node::Finished || node_ == Node::NotPlain) return;
            node_ = xml_.next();
        }
        const char* const uniqueCount = xml_.attribute("uniqueCount");
        if (!uniqueCount) return;
        entries_.begin(uniqueCount);
        while (visitNext()) {
        }
    }

    bool isElement() const { return node_ == Node::Start || node_ == Node::Empty; }

    // False at the end of the table.
    bool visitNext() {
        if (xml_.isInsideRoot() && !entries_.hasBegunEntry()) takeEntries();
        node_ = xml_.next();
        if (node_ == Node::Text) addText(xml_.text());
        if (node_ == Node::End && xml_.name() == "sst") return false;
        if ((node_ == Node::End || node_ == Node::Empty) && xml_.name() == "si")
            entries_.endEntry();
        return node_ != Node::Finished && node_ != Node::NotPlain;
    }

    // White space counts as text only inside a `t`: elsewhere it is the indentation.
    void addText(std::string_view text) {
        const bool blank = text.find_first_not_of(" \t\r\n") == text.npos;
        if (!blank || xml_.parentName() == "t") entries_.addText(text);
    }

    // <si><t>Text</t></si>, which nearly all entries look like.
    void takeEntries() {
        constexpr std::string_view kBegin = "<si><t>";
        constexpr std::string_view kEnd = "</t></si>";
        for (;;) {
            char* const entry = xml_.ahead();
            if (std::strncmp(entry, kBegin.data(), kBegin.size()) != 0) return;
            char* const text = entry + kBegin.size();
            char* const end = PlainXml::endOfOrdinaryText(text);
            if (static_cast<unsigned char>(*text) <= ' ' || *text == '<' ||
                std::strncmp(end, kEnd.data(), kEnd.size()) != 0)
                return;
            entries_.addEntry({text, static_cast<std::size_t>(end - text)});
            xml_.skipTo(end + kEnd.size());
        }
    }

    PlainXml& xml_;
    SharedStringEntries& entries_;
    Node node_ = Node::NotPlain;
};

}  // namespace

bool readPlainSharedStrings(const std::string& path, SharedStringTable& table,
                            ReadingWindow window) {
    PlainXml xml(window);
    SharedStringEntries entries(table, path);
    return xml.open(path) && PlainSharedStrings(xml, entries).run();
}

}  // namespace dp
