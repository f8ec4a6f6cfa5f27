# cmake -D FOLDER=... -D OUTPUT=... -P embed-page.cmake: puts page.css and page.js of the folder into its
# page.html, with their hashes for the page's security policy, and the whole as bytes into a C++ source.

# The SHA-256 of a text in base 64, as security policies have it.
function(policy_hash text result)
    set(alphabet ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz0123456789+/)
    string(SHA256 digits "${text}")
    string(APPEND digits "00")  # 33 bytes are 22 groups of three digits
    set(hash "")
    foreach(place RANGE 0 63 3)
        string(SUBSTRING ${digits} ${place} 3 group)
        math(EXPR first "0x${group} / 64")
        math(EXPR second "0x${group} % 64")
        string(SUBSTRING ${alphabet} ${first} 1 first)
        string(SUBSTRING ${alphabet} ${second} 1 second)
        string(APPEND hash ${first}${second})
    endforeach()
    string(REGEX REPLACE "A$" "=" hash ${hash})
    set(${result} "sha256-${hash}" PARENT_SCOPE)
endfunction()

file(READ "${FOLDER}/page.html" page)
file(READ "${FOLDER}/page.css" style)
file(READ "${FOLDER}/page.js" script)
policy_hash("${style}" style_hash)
policy_hash("${script}" script_hash)
foreach(name IN ITEMS style_hash script_hash style script)
    string(TOUPPER "@${name}@" mark)
    string(REPLACE "${mark}" "${${name}}" page "${page}")
endforeach()

file(WRITE "${OUTPUT}.html" "${page}")
file(READ "${OUTPUT}.html" bytes HEX)
string(REGEX REPLACE "([0-9a-f][0-9a-f])" "0x\\1," bytes "${bytes}")
string(REPEAT "[^,]*," 16 line)
string(REGEX REPLACE "(${line})" "\\1\n    " bytes "${bytes}")
file(WRITE "${OUTPUT}" "#include \"tools/page/page_template.h\"

namespace dp::tool {

namespace {

constexpr unsigned char kPage[] = {
    ${bytes}
};

}  // namespace

std::string_view pageTemplate() {
    return {reinterpret_cast<const char*>(kPage), sizeof kPage};
}

}  // namespace dp::tool
")
