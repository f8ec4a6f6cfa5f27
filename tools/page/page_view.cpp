#include "tools/page/page_view.h"

#include <string_view>

#include "tools/explain/explain.h"
#include "tools/page/page_data.h"
#include "tools/page/page_template.h"

namespace dp::tool {

void writePage(const Library& library, Workbook& workbook, const Options& options, Output& output) {
    const std::vector<Trait> traits = findTraits(library, options);
    workbook.open();
    const std::string data = embeddable(pageData(workbook, options, traits));
    const std::string_view page = pageTemplate();
    const size_t place = page.find(kDataMark);
    output.write(page.substr(0, place));
    output.write(data);
    output.write(page.substr(place + kDataMark.size()));
}

}  // namespace dp::tool
