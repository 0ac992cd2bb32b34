"""The pages of `orlith view` in a real browser.

    page_test.py PROGRAM      exit status 77: there is no Chromium, or no Selenium, to show them

Each page is opened from disk; what the pointer reads is compared with `orlith eval`.
"""

import base64
import json
import re
import shutil
import subprocess
import sys
import tempfile
import unittest
import zlib
from pathlib import Path

SKIPPED = 77

try:
    from selenium import webdriver
    from selenium.webdriver.common.action_chains import ActionChains
    from selenium.webdriver.common.actions.action_builder import ActionBuilder
    from selenium.webdriver.common.actions.pointer_input import PointerInput
    from selenium.webdriver.common.by import By
    from selenium.webdriver.common.keys import Keys
except ImportError as missing:
    print(f"skipped: {missing}")
    sys.exit(SKIPPED)

CHROMIUM = shutil.which("chromium")
DRIVER = shutil.which("chromedriver")
if not CHROMIUM or not DRIVER:
    print("skipped: chromium and chromedriver are needed")
    sys.exit(SKIPPED)

PROGRAM = str(Path(sys.argv[1]).resolve())

# A name that would run as a script, close the page's own, or end the data, if it were let in.
EVIL = "a<img src=x onerror=alert(1)>&{{data}}'\".cube"

# Pixels of a canvas that differ from its first: none if nothing was drawn.
DRAWN_PIXELS = """
const canvas = arguments[0];
const copy = document.createElement("canvas");
copy.width = canvas.width; copy.height = canvas.height;
const context = copy.getContext("2d");
context.drawImage(canvas, 0, 0);
const data = context.getImageData(0, 0, copy.width, copy.height).data;
let count = 0;
for (let i = 0; i < data.length; i += 4)
    for (let c = 0; c < 4; ++c) if (data[i + c] !== data[c]) { ++count; break; }
return count;
"""


def lattice(look, points=9):
    steps = [i / (points - 1) for i in range(points)]
    rows = [look(r, g, b) for b in steps for g in steps for r in steps]
    return f"LUT_3D_SIZE {points}\n" + "".join("%.6f %.6f %.6f\n" % row for row in rows)


def warm(r, g, b):
    return (r**0.8, 0.9 * g**0.9 + 0.1 * r, 0.8 * b + 0.1 * g)


def damaged(r, g, b):
    isPlace = (r, g, b) == (0.5, 0.75, 0.25)
    return (r, g + (0.6 if isPlace else 0), b)


def images_of(pdf):
    """Width and bytes of each image that a PDF holds without loss."""
    for match in re.finditer(rb"/Subtype /Image\s(.*?)>>\s*stream\r?\n", pdf, re.DOTALL):
        if b"/FlateDecode" in match[1]:
            yield int(re.search(rb"/Width (\d+)", match[1])[1]), zlib.decompressobj().decompress(pdf[match.end():])


def browser(*arguments):
    options = webdriver.ChromeOptions()
    options.binary_location = CHROMIUM
    for argument in ("--headless=new", "--no-sandbox", "--disable-dev-shm-usage", "--window-size=1400,1000", *arguments):
        options.add_argument(argument)
    options.set_capability("goog:loggingPrefs", {"browser": "ALL"})
    service = webdriver.chrome.service.Service(DRIVER)
    return webdriver.Chrome(service=service, options=options)


class PageTest(unittest.TestCase):
    @classmethod
    def setUpClass(cls):
        cls.folder = tempfile.TemporaryDirectory()
        cls.addClassCleanup(cls.folder.cleanup)
        path = Path(cls.folder.name)
        (path / "warm.cube").write_text(lattice(warm))
        (path / "plain.cube").write_text(lattice(lambda r, g, b: (r, g, b), 5))
        (path / EVIL).write_text(lattice(damaged))
        (path / "curve.cube").write_text("LUT_1D_SIZE 3\nDOMAIN_MIN -1 -1 -1\nDOMAIN_MAX 3 3 3\n0 0 0\n0.3 0.2 0.1\n1 1 1\n")
        # Software rendering: the same picture on every machine.
        cls.driver = browser("--use-angle=swiftshader", "--enable-unsafe-swiftshader")
        cls.addClassCleanup(cls.driver.quit)

    def run_program(self, *arguments):
        return subprocess.run([PROGRAM, *arguments], cwd=self.folder.name, capture_output=True, text=True, check=True).stdout

    def open(self, *arguments, driver=None):
        """Makes the page of a table, and opens it; the browser has nothing to complain of."""
        driver = driver or self.driver
        self.run_program("view", *arguments, "--output", "page.html")
        driver.get("about:blank")
        driver.get_log("browser")
        driver.get((Path(self.folder.name) / "page.html").as_uri())
        self.assertEqual([], [line["message"] for line in driver.get_log("browser")])
        asked = driver.execute_script("return performance.getEntriesByType('resource').map((each) => each.name)")
        self.assertEqual([], [name for name in asked if not name.startswith("data:")])

    def element(self, selector):
        return self.driver.find_element(By.CSS_SELECTOR, selector)

    def colour(self, selector):
        return self.element(selector).text.split()

    def point_at(self, canvas, x, y):
        """Puts the pointer to a part, 0 to 1, of a canvas from its top left."""
        self.driver.execute_script("arguments[0].scrollIntoView({block: 'center'})", canvas)
        box = canvas.rect
        ActionChains(self.driver).move_to_element_with_offset(
            canvas, int((x - 0.5) * box["width"]), int((y - 0.5) * box["height"])).perform()

    def assert_all_drawn(self):
        for selector, least in ((".cloud canvas", 1000), (".chart canvas", 1000), ("#slices canvas", 3)):
            canvases = self.driver.find_elements(By.CSS_SELECTOR, selector)
            self.assertGreaterEqual(len(canvases), 2)
            for canvas in canvases:
                self.assertGreater(self.driver.execute_script(DRAWN_PIXELS, canvas), least, selector)

    def test_values_under_the_pointer_are_those_of_eval(self):
        for table, options in (("warm.cube", ["--mode", "cubic"]), ("curve.cube", []), ("warm.cube", ["--strict"])):
            with self.subTest(table=table, options=options):
                self.open(table, *options)
                self.assert_all_drawn()
                self.assertLess(len(Path(self.folder.name, "page.html").read_bytes()), 4_000_000)
                curve = self.element("#curve-chart")
                seen = []
                for place in (0.3, 0.71):
                    self.point_at(curve, place, 0.5)
                    seen.append(self.colour("#curve-in"))
                    self.assertEqual(self.run_program("eval", table, *options, *seen[-1]).split(), self.colour("#curve-out-0"))
                self.assertNotEqual(*seen)
                curve.send_keys(Keys.END)
                self.assertEqual(["3" if table == "curve.cube" else "1"] * 3, self.colour("#curve-in"))

                self.point_at(self.element(".slice canvas"), 0.2, 0.9)
                place = self.colour("#slice-in")
                output = self.run_program("eval", table, *options, *place).split()
                for shown, exact in zip(self.colour("#slice-out-0"), output):
                    self.assertAlmostEqual(float(shown), float(exact), delta=1e-4)

    def test_a_tap_reads_values(self):
        self.open("warm.cube")
        for canvas, shown in (("#curve-chart", "#curve-in"), (".slice canvas", "#slice-in")):
            before = self.colour(shown)
            canvas = self.element(canvas)
            self.driver.execute_script("arguments[0].scrollIntoView({block: 'center'})", canvas)
            actions = ActionBuilder(self.driver, mouse=PointerInput("touch", "finger"))
            actions.pointer_action.move_to(canvas, int(0.3 * canvas.rect["width"])).pointer_down().pointer_up()
            actions.perform()
            self.assertNotEqual(before, self.colour(shown))

    def test_a_fault_is_a_click_from_its_place(self):
        self.open(EVIL)
        self.assertEqual(EVIL, self.element("h1").text)
        self.assertEqual(EVIL, self.driver.title)
        texts = [fault["text"] for fault in json.loads(self.run_program("info", "--json", EVIL))["faults"]]
        buttons = self.driver.find_elements(By.CSS_SELECTOR, ".faults button")
        self.assertEqual(texts, [button.text.split("\n")[-1] for button in buttons])
        jump = next(button for button in buttons if "jumps" in button.text)
        jump.send_keys(Keys.ENTER)
        self.assertEqual(["0.5", "0.75", "0.25"], self.colour("#slice-in"))
        self.assertAlmostEqual(1.35, float(self.colour("#slice-out-0")[1]), delta=1e-4)

    def test_the_slider_divides_the_picture(self):
        self.open("warm.cube")
        slider, picture = self.element("#picture-split"), self.element(".split")
        self.driver.execute_script("arguments[0].scrollIntoView({block: 'center'})", picture)
        shown = []
        for key in (Keys.HOME, Keys.END):
            slider.send_keys(key)
            shown.append(picture.screenshot_as_png)
        images = [image.get_attribute("src") for image in picture.find_elements(By.TAG_NAME, "img")]
        self.assertNotEqual(*images)
        self.assertNotEqual(*shown)

    def test_two_tables_show_their_difference(self):
        self.open("warm.cube", "plain.cube")
        self.assert_all_drawn()
        process = subprocess.run([PROGRAM, "diff", "--json", "warm.cube", "plain.cube"], cwd=self.folder.name, capture_output=True, text=True)
        expected = json.loads(process.stdout)
        rows = self.driver.find_elements(By.CSS_SELECTOR, "#difference tbody tr")
        for row, channel in zip(rows, ("red", "green", "blue"), strict=True):
            self.assertAlmostEqual(float(row.text.split()[1]), expected[channel]["largest"], delta=1e-6)
        self.point_at(self.element(".slice canvas"), 0.4, 0.3)
        place = self.colour("#slice-in")
        a, b = ([float(value) for value in self.run_program("eval", name, *place).split()] for name in ("warm.cube", "plain.cube"))
        apart = max(abs(x - y) for x, y in zip(a, b))
        self.assertGreater(apart, 0.01)
        self.assertAlmostEqual(float(self.element("#slice-difference").text), apart, delta=2e-4)

    def test_prints_on_two_pages(self):
        for tables in (["warm.cube"], [EVIL, "plain.cube"]):
            self.open(*tables)
            slices = max(canvas.get_property("width") for canvas in self.driver.find_elements(By.CSS_SELECTOR, "#slices canvas"))
            printed = self.driver.execute_cdp_cmd("Page.printToPDF", {"preferCSSPageSize": True, "printBackground": True})
            pdf = base64.b64decode(printed["data"])
            self.assertEqual(2, len(re.findall(rb"/Type /Page\b", pdf)), tables)
            clouds = [image for width, image in images_of(pdf) if width > slices]
            self.assertEqual(1 + len(tables), len(clouds))
            for cloud in clouds:
                self.assertGreater(len(set(cloud)), 100, "a cloud is blank on paper")
                self.assertEqual(b"\xff" * 3, cloud[:3], "a cloud on paper has the background of the screen")

    def test_without_webgl_it_says_so(self):
        driver = browser("--disable-3d-apis")
        self.addCleanup(driver.quit)
        self.open("warm.cube", driver=driver)
        self.assertIn("no WebGL", driver.find_element(By.ID, "cloud-caption").text)
        self.assertEqual(9 + 2, len(driver.find_elements(By.CSS_SELECTOR, "#slices canvas")))


if __name__ == "__main__":
    unittest.main(argv=sys.argv[:1])
