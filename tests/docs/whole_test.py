"""What no single page can tell: links between them, and tables that must be complete."""
import re
import unittest

import harness

DOCS = harness.ROOT / "docs"
README = (harness.ROOT / "README.md").read_text(encoding="utf-8")


def pages():
    return [*(harness.ROOT / name for name in ("README.md", "CHANGELOG.md", "SECURITY.md")), *sorted(DOCS.rglob("*.md"))]


def links_of(text):
    """The places that a page leads to, without what lies outside."""
    return [link for link in re.findall(r"\]\(([^)]+)\)", text) if "://" not in link]


def missing_links(page):
    return [link for link in links_of(page.read_text(encoding="utf-8"))
            if not (page.parent / link.split("#")[0]).exists()]


class WholeTest(harness.CliTest):
    def test_links_lead_somewhere(self):
        for page in pages():
            with self.subTest(page.name):
                self.assertEqual(missing_links(page), [])

    def test_every_page_can_be_found(self):
        """A page that nothing leads to is read by nobody."""
        led_to = {(page.parent / link.split("#")[0]).resolve() for page in pages()
                  for link in links_of(page.read_text(encoding="utf-8"))}
        alone = [page for page in DOCS.rglob("*.md") if page.resolve() not in led_to and page.parent.name != "adr"]
        self.assertEqual(alone, [])

    def test_sources_are_shown_as_they_are(self):
        shown = re.findall(r"^```cpp (\S+)\n(.*?)^```$", README, re.M | re.S)
        self.assertGreater(len(shown), 0)
        for path, text in shown:
            self.assertIn(text, (harness.ROOT / path).read_text(encoding="utf-8"), path)

    def test_every_picture_is_shown(self):
        shown = "".join(page.read_text(encoding="utf-8") for page in pages())
        self.assertEqual([p.name for p in DOCS.glob("images/*.png") if p.name not in shown], [])

    def test_the_readme_tells_of_every_command(self):
        listed = self.run_program("--help").out.split("Commands:\n")[1].split("\n\n")[0]
        commands = re.findall(r"^  (\S+)", listed, re.M)
        self.assertIn("convert", commands)
        self.assertEqual([name for name in commands if "`%s`" % name not in README], [])

    def test_the_readme_says_why_each_package_is_needed(self):
        script = (harness.ROOT / "build.sh").read_text()
        packages = " ".join(re.findall(r"^packages_\w+=\((.*)\)", script, re.M)).split()
        self.assertIn("cmake", packages)
        self.assertEqual([name for name in packages if "`%s`" % name not in README], [])

    def test_the_architecture_has_every_room(self):
        rooms = {str(path.parent.relative_to(harness.ROOT)) + "/" for path in harness.ROOT.rglob("CMakeLists.txt")
                 if re.search(r"^gw_room\(", path.read_text(), re.M) and "tests" not in path.parts}
        text = (DOCS / "architecture.md").read_text(encoding="utf-8")
        rooms.discard("preview/gl/")  # named with the preview
        self.assertIn("math/", rooms)
        self.assertEqual([room for room in sorted(rooms) if "`%s`" % room not in text], [])


if __name__ == "__main__":
    unittest.main()
