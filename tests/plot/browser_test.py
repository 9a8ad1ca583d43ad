"""Opens reports in a browser. Usage: browser_test.py TOOL SOURCES"""

import base64
import json
import pathlib
import shutil
import subprocess
import sys
import tempfile
import unittest

from selenium import webdriver
from selenium.webdriver.chrome.service import Service
from selenium.webdriver.common.by import By
from selenium.webdriver.common.keys import Keys

TOOL = pathlib.Path(sys.argv[1]).resolve()
EXAMPLES = pathlib.Path(sys.argv[2]) / "examples"
EVIL = '"><img src=x onerror=alert(1)>&lt;.ies'


def start_browser(profile):
    options = webdriver.ChromeOptions()
    options.binary_location = "/usr/bin/chromium"
    for argument in ("--headless=new", "--no-sandbox", "--disable-gpu", "--disable-dev-shm-usage",
                     "--window-size=1200,1000", f"--user-data-dir={profile}"):
        options.add_argument(argument)
    options.set_capability("goog:loggingPrefs", {"browser": "ALL", "performance": "ALL"})
    return webdriver.Chrome(service=Service("/usr/bin/chromedriver"), options=options)


class Report(unittest.TestCase):
    @classmethod
    def setUpClass(cls):
        cls.temporary = tempfile.TemporaryDirectory()
        cls.folder = pathlib.Path(cls.temporary.name)
        lamps = cls.folder / "lamps"
        shutil.copytree(EXAMPLES, lamps)
        text = (EXAMPLES / "downlight.ies").read_text()
        (lamps / EVIL).write_text(text.replace("[LUMINAIRE] ", "[LUMINAIRE] </title></script><script>alert(2)</script>"))
        (lamps / "bad.ies").write_text("IESNA91\nTILT=NONE\nx\n")
        done = subprocess.run([TOOL, "report", "lamps", "-o", "in dex#1.html"], cwd=cls.folder, check=False)
        assert done.returncode == 1, "one file is refused"
        cls.browser = start_browser(cls.folder / "profile")
        cls.browser.get("data:,")
        cls.browser.get_log("performance")  # of the browser's own first page

    @classmethod
    def tearDownClass(cls):
        cls.browser.quit()
        cls.temporary.cleanup()

    def setUp(self):
        self.browser.get((self.folder / "in dex#1.html").as_uri())

    def tearDown(self):
        """Nothing was complained of, and nothing asked for but the pages themselves."""
        self.assertEqual(self.browser.get_log("browser"), [])
        for entry in self.browser.get_log("performance"):
            message = json.loads(entry["message"])["message"]
            if message["method"] == "Network.requestWillBeSent":
                url = message["params"]["request"]["url"]
                self.assertTrue(url.startswith((self.folder.as_uri(), "data:")), url)

    def all(self, selector):
        return self.browser.find_elements(By.CSS_SELECTOR, selector)

    def one(self, selector):
        return self.browser.find_element(By.CSS_SELECTOR, selector)

    def open_page(self, word):
        next(link for link in self.all("#files a") if word in link.text).click()

    def column(self, number):
        cells = self.all(f"#files tbody tr > :nth-child({number})")
        return [float(cell.get_attribute("data-value")) for cell in cells]

    def test_index_sorts(self):
        self.assertEqual(len(self.all("#files tbody tr")), 6)
        self.assertEqual(len(self.all("#files tbody svg[role=img] title")), 5)
        heading = next(h for h in self.all("#files thead th") if h.text.startswith("Flux"))
        before = self.column(5)
        for order, backwards in (("ascending", False), ("descending", True)):
            heading.find_element(By.TAG_NAME, "button").send_keys(Keys.ENTER)
            self.assertEqual(heading.get_attribute("aria-sort"), order)
            self.assertEqual(self.column(5), sorted(before, reverse=backwards))
        next(h for h in self.all("#files thead button") if h.text == "Symmetry").click()
        self.assertEqual(len(self.all("#files thead [aria-sort]")), 1)

    def test_index_filters(self):
        label = self.one("label")
        box = self.one("#" + label.get_attribute("for"))
        box.send_keys("FLOOD ies")
        self.assertEqual([row.is_displayed() for row in self.all("#files tbody tr")].count(True), 1)
        self.assertEqual(self.one("#shown").text, "1 of 6 files")
        box.clear()
        box.send_keys("refused")
        self.assertIn("bad.ies", next(row for row in self.all("#files tbody tr") if row.is_displayed()).text)

    def test_names_and_labels_are_text(self):
        self.assertEqual(self.all("img"), [])
        self.open_page(EVIL)
        self.assertEqual(self.browser.title, "</title></script><script>alert(2)</script>Recessed LED downlight, "
                                             "118 mm, medium beam")
        self.assertEqual(len(self.all("script")), 2)
        self.one(".back a").click()
        self.assertEqual(self.browser.title, "Photometric files")

    def test_nothing_but_the_pages_own_style_and_script_runs(self):
        seen = self.browser.execute_script("""
            const script = document.createElement("script"), style = document.createElement("style");
            script.textContent = "window.foreign = true";
            style.textContent = "h1 { display: none }";
            document.body.append(script, style);
            document.body.setAttribute("style", "display: none");
            return [window.foreign ?? null, getComputedStyle(document.querySelector("h1")).display,
                    getComputedStyle(document.body).display];""")
        self.assertEqual(seen, [None, "block", "block"])
        refusals = [entry["message"] for entry in self.browser.get_log("browser")]
        self.assertEqual(len([text for text in refusals if "Content Security Policy" in text]), 3)

    def test_the_solid_turns(self):
        self.open_page("wallwasher")
        canvas = self.one("#solid canvas")
        seen = set()

        def look():
            seen.add(self.browser.execute_script("return arguments[0].toDataURL()", canvas))
            return canvas.get_attribute("aria-label")

        self.assertIn("turned by 315 degrees", look())
        canvas.send_keys(Keys.ARROW_RIGHT)
        self.assertIn("turned by 325 degrees", look())
        next(button for button in self.all("#solid button") if button.text == "Tilt up").click()
        self.assertIn("45 degrees above", look())
        webdriver.ActionChains(self.browser).drag_and_drop_by_offset(canvas, 60, 0).perform()
        self.assertNotIn("turned by 325", look())
        self.assertEqual(len(seen), 4)

    def test_pages_tell_everything_and_have_unique_ids(self):
        self.open_page("area-light")
        self.assertEqual(len(self.all("figure svg[role=img], figure canvas[role=img]")), 5)
        ids = self.browser.execute_script("return [...document.querySelectorAll('[id]')].map(e => e.id)")
        self.assertEqual(len(ids), len(set(ids)))
        dangling = self.browser.execute_script(
            "return [...document.querySelectorAll('use')].filter(u => !document.getElementById("
            "u.href.baseVal.slice(1))).length")
        self.assertEqual(dangling, 0)
        text = self.one("main").text
        for fact in ("Quarter", "19 angles, 0 to 90 deg", "20500 lm", "Harrow Vale", "tilt data is read but not"):
            self.assertIn(fact, text)
        table = self.one("table.candela")
        self.assertEqual(len(table.find_elements(By.CSS_SELECTOR, "thead th[scope=col]")), 6)
        self.assertEqual(len(table.find_elements(By.CSS_SELECTOR, "tbody th[scope=row]")), 19)

    def test_dark_paper_and_no_script(self):
        self.open_page("downlight")
        colour = "return getComputedStyle(document.body).backgroundColor"
        for scheme, expected in (("dark", "rgb(0, 0, 0)"), ("light", "rgb(255, 255, 255)")):
            self.browser.execute_cdp_cmd("Emulation.setEmulatedMedia",
                                         {"features": [{"name": "prefers-color-scheme", "value": scheme}]})
            self.assertEqual(self.browser.execute_script(colour), expected)
        pdf = base64.b64decode(self.browser.print_page())
        self.assertTrue(pdf.startswith(b"%PDF") and len(pdf) > 20000)
        try:
            self.browser.execute_cdp_cmd("Emulation.setScriptExecutionDisabled", {"value": True})
            self.browser.refresh()
            self.assertTrue(self.one("#solid svg").is_displayed())
        finally:
            self.browser.execute_cdp_cmd("Emulation.setScriptExecutionDisabled", {"value": False})


if __name__ == "__main__":
    unittest.main(argv=sys.argv[:1])
