// The text rules of the HTML back-ends: values become text, names become
// file names inside the report, and the logic's own cell mark-up survives.
#include <gtest/gtest.h>

#include "HtmlText.h"

namespace braigrion {
namespace backends {
namespace {

TEST(EscapeHtml, MakesValuesText) {
    struct {
        std::string in;
        std::string out;
    } cases[] = {
        {"<script>x</script>", "&lt;script&gt;x&lt;/script&gt;"},
        {"a \"b\" 'c' & d", "a &quot;b&quot; &#39;c&#39; &amp; d"},
        {"AT&T &lt; &#60; &#x3C; &amp;", "AT&amp;T &lt; &#60; &#x3C; &amp;"},  // references stay
        {"&;&#;&#x;&#12345678;&abc", "&amp;;&amp;#;&amp;#x;&amp;#12345678;&amp;abc"},
        {"Äpfel – ünïcödé 🙂", "Äpfel – ünïcödé 🙂"},
        {"tab\tline\nfeed\r", "tab\tline\nfeed\r"},
        {std::string("nul\0!", 5), "nul\xEF\xBF\xBD!"},
        {"bell\aesc\x1b" "del\x7f", "bell\xEF\xBF\xBD" "esc\xEF\xBF\xBD" "del\xEF\xBF\xBD"},
        {"bad \xC3 byte \xFF, overlong \xC0\xAF, surrogate \xED\xA0\x80",
         "bad \xEF\xBF\xBD byte \xEF\xBF\xBD, overlong \xEF\xBF\xBD\xEF\xBF\xBD, surrogate "
         "\xEF\xBF\xBD\xEF\xBF\xBD\xEF\xBF\xBD"},
    };
    for (const auto& c : cases) {
        EXPECT_EQ(c.out, EscapeHtml(c.in)) << c.in;
        EXPECT_EQ(EscapeHtml(c.in), EscapeHtml(EscapeHtml(c.in))) << "escaping twice changes nothing: " << c.in;
    }
}

TEST(SanitizeCellMarkup, KeepsOnlyTheLogicsOwnTags) {
    struct {
        const char* in;
        const char* out;
    } cases[] = {
        {"one<br>two<BR/>three", "one<br>two<br>three"},
        {"<font face=\"Courier\">ls -l</font>", "<font face=\"Courier\">ls -l</font>"},
        {"<a href=\"pci_raw_data_0.txt\">View Results</a>", "<a href=\"pci_raw_data_0.txt\">View Results</a>"},
        {"<a href= \"fio dump\">View</a>", "<a href=\"fio dump\">View</a>"},
        {"<a href=\"../x.txt\">x</a>", "&lt;a href=&quot;../x.txt&quot;&gt;x&lt;/a&gt;"},
        {"<a href=\"x.txt\" onclick=\"y\">x</a>", "&lt;a href=&quot;x.txt&quot; onclick=&quot;y&quot;&gt;x&lt;/a&gt;"},
        {"<font face=\"Courier\">open", "<font face=\"Courier\">open</font>"},  // closed at the end
        {"</font>stray</a>", "&lt;/font&gt;stray&lt;/a&gt;"},
        {"<font face=\"Courier\"><a href=\"x\">a</font></a>",
         "<font face=\"Courier\"><a href=\"x\">a&lt;/font&gt;</a></font>"},  // closers must nest
        {"<script>alert(1)</script> &lt;kept&gt;", "&lt;script&gt;alert(1)&lt;/script&gt; &lt;kept&gt;"},
        {"1 < 2 > 0", "1 &lt; 2 &gt; 0"},
        {"<a href=\"java&#115;cript&#58;alert(6)\">x</a>",
         "&lt;a href=&quot;java&#115;cript&#58;alert(6)&quot;&gt;x&lt;/a&gt;"},  // no link, and as text harmless
        {"<a href=\"page&#46;html\">p</a>", "<a href=\"page.html\">p</a>"},
    };
    for (const auto& c : cases) EXPECT_EQ(c.out, SanitizeCellMarkup(c.in)) << c.in;
}

TEST(SafeHref, AllowsReportFilesAndWebAddressesOnly) {
    struct {
        const char* link;
        bool web;
        const char* out;
    } cases[] = {
        {"lsi_mir.html", false, "lsi_mir.html"},
        {"raw/out 1.txt", false, "raw/out 1.txt"},
        {"https://docs.example.com/a?b=1&c=2", true, "https://docs.example.com/a?b=1&c=2"},
        {"https://docs.example.com/", false, ""},
        {"HTTP://x", true, "HTTP://x"},
        {"https://", true, ""},
        {"javascript:alert(1)", true, ""},
        {"../up.html", false, ""},
        {"a/../../up", false, ""},
        {"/abs", false, ""},
        {"//host/x", true, ""},
        {"a\"b", false, ""},
        {"a\nb", false, ""},
        {"", true, ""},
        // Judged as the browser decodes the attribute, and handed back decoded.
        {"java&#115;cript&#58;alert(6)", true, ""},
        {"javascript&colon;alert(1)", true, ""},
        {"&#106;avascript:alert(1)", false, ""},
        {"&#x6A;avascript&#x3A;alert(1)", true, ""},
        {"jav&#x09;ascript:alert(1)", true, ""},
        {"jav&Tab;ascript:alert(1)", true, ""},
        {"java&amp;#115;cript&amp;#58;alert(1)", false, ""},  // decoded, it still holds references
        {"&#46;&#46;/up.html", false, ""},
        {"&#47;abs", false, ""},
        {"page&#46;html", false, "page.html"},
        {"https://docs.example.com/a?b=1&amp;c=2", true, "https://docs.example.com/a?b=1&c=2"},
    };
    for (const auto& c : cases) EXPECT_EQ(c.out, SafeHref(c.link, c.web)) << c.link;
}

TEST(SafeFileStem, KeepsNamesInsideTheReport) {
    struct {
        const char* name;
        const char* stem;
    } cases[] = {
        {"SystemConfig", "SystemConfig"},
        {"lsi_rawData", "lsi_rawData"},
        {"../../etc/passwd", "___.._etc_passwd"},
        {"..", "__"},
        {".hidden", "_hidden"},
        {"a/b\\c", "a_b_c"},
        {"name with <tags>", "name_with__tags_"},
        {"ünï", "__n__"},
        {"index", "page_index"},
        {"NavBar", "page_NavBar"},
        {"", "page"},
    };
    for (const auto& c : cases) EXPECT_EQ(c.stem, SafeFileStem(c.name)) << c.name;
}

}  // namespace
}  // namespace backends
}  // namespace braigrion
