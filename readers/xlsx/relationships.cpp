#include "dpxlsx/readers/xlsx/relationships.h"

#include <utility>

#include "dpxlsx/readers/limits.h"
#include "dpxlsx/readers/xml/xml_reader.h"

namespace dp {

namespace {

constexpr std::size_t kFirstCapacity = 10;

bool isWorksheetType(const std::string& type) {
    const std::size_t slash = type.rfind('/');
    return slash != type.npos && slash != 0 && type.compare(slash + 1, type.npos, "worksheet") == 0;
}

// Two lists of one size that grow together.
class RelationshipLists {
  public:
    RelationshipLists(std::vector<std::string>& ids, std::vector<std::string>& targets)
        : ids_(ids), targets_(targets) {
        ids_.clear();
        targets_.clear();
        resize(kFirstCapacity);
    }

    void add(std::string id, std::string target) {
        if (count_ == ids_.size()) resize(2 * count_);
        ids_[count_] = std::move(id);
        targets_[count_] = std::move(target);
        ++count_;
    }

  private:
    void resize(std::size_t size) {
        ids_.resize(size);
        targets_.resize(size);
    }

    std::vector<std::string>& ids_;
    std::vector<std::string>& targets_;
    std::size_t count_ = 0;
};

}  // namespace

void mReadWorkbookRelationships(const std::string& xlDir, std::vector<std::string>& ids,
                                std::vector<std::string>& targets) {
    RelationshipLists lists(ids, targets);
    XmlReader reader;
    reader.mInitialize(xlDir + "/_rels/workbook.xml.rels");
    if (!reader.mGotoElement("Relationships")) throw CmXmlException(kXmlError);
    do {
        if (std::string_view(reader.nodeName()) != "Relationship") continue;
        std::string id = reader.attributeText("Id");
        std::string target = reader.attributeText("Target");
        if (isWorksheetType(reader.attributeText("Type")))
            lists.add(std::move(id), std::move(target));
    } while (reader.readToElement());
}

RelationshipIndex::RelationshipIndex(const std::vector<std::string>& ids) {
    for (std::size_t i = 0; i < ids.size(); ++i) firstById_.try_emplace(ids[i], i);
}

std::ptrdiff_t RelationshipIndex::find(const std::string& id) const {
    const auto entry = firstById_.find(id);
    return entry == firstById_.end() ? -1 : static_cast<std::ptrdiff_t>(entry->second);
}

std::string resolveTarget(const std::string& dir, const std::string& target) {
    if (target.size() > kTargetSize) throw CmXmlException(kXmlError);
    std::vector<std::string_view> segments;
    std::string_view rest = target;
    if (target.empty() || target.front() != '/') segments.emplace_back("xl");
    while (!rest.empty()) {
        const std::size_t slash = rest.find('/');
        const std::string_view segment = rest.substr(0, slash);
        rest.remove_prefix(slash == rest.npos ? rest.size() : slash + 1);
        if (segment.empty() || segment == ".") continue;
        if (segment != "..") {
            segments.push_back(segment);
        } else {
            if (segments.empty()) throw CmXmlException(kXmlError);
            segments.pop_back();
        }
    }
    std::string path = dir;
    for (const std::string_view segment : segments) path.append("/").append(segment);
    return path;
}

}  // namespace dp
