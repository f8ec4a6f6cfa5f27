#pragma once

namespace dp::standard {

// What the names of elements and attributes mean, by their namespace.
enum class Vocabulary {
    None,           // no namespace
    Spreadsheet,    // workbooks, worksheets, styles, shared strings
    Relationships,  // references from one part to another, as r:id
    Package,        // the relationships and content types of a package
    Compatibility,  // alternatives for programs that know more or less
    Foreign,
};

// The vocabulary of a namespace, in its transitional or strict form; null is none.
Vocabulary vocabularyOf(const char* namespaceName);

}  // namespace dp::standard
