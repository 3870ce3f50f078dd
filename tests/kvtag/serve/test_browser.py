"""The page of kvtag serve in headless Chromium, driven by Selenium."""

import os
import tempfile
import time
import urllib.parse

import pytest
from conftest import kvtag

webdriver = pytest.importorskip("selenium.webdriver", reason="python3-selenium is not installed")
from selenium.common.exceptions import (  # noqa: E402
    NoAlertPresentException, WebDriverException)
from selenium.webdriver.chrome.service import Service  # noqa: E402
from selenium.webdriver.common.by import By  # noqa: E402
from selenium.webdriver.support.ui import WebDriverWait  # noqa: E402

HOSTILE = "serve.browser.<img src=x onerror=alert(1)>"
FLOW = "serve.browser.flow"
# The table's rows as texts, and a plotted line's number of points.
ROWS = ("return Array.from(document.querySelectorAll('#tags tbody tr'))"
        ".map(r => Array.from(r.cells).map(c => c.textContent));")
POINTS = ("const line = Array.from(document.querySelectorAll('#trend polyline'))"
          ".find(l => l.getAttribute('data-path') === arguments[0]);"
          "return line ? line.getAttribute('points').trim().split(/\\s+/).length : 0;")


@pytest.fixture(scope="module")
def browser():
    profile = tempfile.TemporaryDirectory(prefix="kvtag-serve-chromium.")
    options = webdriver.ChromeOptions()
    options.binary_location = "/usr/bin/chromium"
    for argument in ("--headless=new", "--no-sandbox", "--disable-gpu", "--window-size=1280,900",
                     f"--user-data-dir={profile.name}"):
        options.add_argument(argument)
    try:
        driver = webdriver.Chrome(service=Service("/usr/bin/chromedriver"), options=options)
    except (WebDriverException, OSError) as error:
        profile.cleanup()
        pytest.skip(f"Chromium cannot start: {error}")
    yield driver
    driver.quit()
    profile.cleanup()


@pytest.fixture(scope="module", autouse=True)
def tags(world):
    kvtag("write", "--stdin", "--type", "double",
          stdin=f"{FLOW} 1\n\"{HOSTILE}\" 2\nserve.browser.level 3\n")
    kvtag("aggregates", FLOW, "--collect", "on")


def rows(driver):
    return {cells[1]: cells for cells in driver.execute_script(ROWS)}


def wait(driver, condition, seconds=10, message=""):
    return WebDriverWait(driver, seconds, poll_frequency=0.1).until(
        lambda d: condition(d), message)


def open_page(driver, served, pattern="serve.browser.*"):
    driver.get(served.url + "?" + urllib.parse.urlencode({"pattern": pattern}))
    wait(driver, lambda d: FLOW in rows(d), message="the page lists no tag")


def test_the_table_and_the_plot_follow_written_values(browser, readonly):
    open_page(browser, readonly)
    assert set(rows(browser)) == {FLOW, HOSTILE, "serve.browser.level"}
    assert not browser.find_elements(By.ID, "write")
    browser.find_element(By.CSS_SELECTOR, f'tr[data-path="{FLOW}"] input.plot').click()
    for value in ("12.5", "17.25", "14"):
        kvtag("write", FLOW, value)
        written = time.monotonic()
        wait(browser, lambda d: rows(d)[FLOW][3] == value, 2, f"{value} not shown within 2 s")
        assert time.monotonic() - written <= 2
        wait(browser, lambda d: value in d.execute_script(
            "return fetch('/api/trend?path=' + encodeURIComponent(arguments[0]))"
            ".then(r => r.json()).then(t => t.points.map(p => p.value));", FLOW))
    wait(browser, lambda d: d.execute_script(POINTS, FLOW) >= 3, 10, "no line of 3 points")
    axis = [label.text for label in browser.find_elements(By.CSS_SELECTOR, "#trend text.axis")]
    assert "17.25" in axis, axis  # the highest value written is the plot's top
    time_cell = browser.find_element(By.CSS_SELECTOR, f'tr[data-path="{FLOW}"] td.time')
    assert time_cell.get_attribute("title").endswith("Z") and time_cell.text != "-"
    if os.environ.get("KVTAG_SCREENSHOT"):
        browser.save_screenshot(os.environ["KVTAG_SCREENSHOT"])


def test_a_hostile_tag_name_is_shown_as_text(browser, readonly):
    open_page(browser, readonly)
    assert rows(browser)[HOSTILE][1] == HOSTILE
    assert browser.execute_script("return document.querySelectorAll('img').length") == 0
    with pytest.raises(NoAlertPresentException):
        browser.switch_to.alert.text


def test_a_tag_that_goes_away_shows_in_the_error_line(browser, readonly):
    kvtag("write", "serve.browser.gone", "1", "--type", "double")
    open_page(browser, readonly)
    wait(browser, lambda d: "serve.browser.gone" in rows(d))
    kvtag("delete", "serve.browser.gone")
    wait(browser, lambda d: "no tag serve.browser.gone" in d.find_element(By.ID, "error").text)
    assert rows(browser)["serve.browser.gone"][3] == "no such tag"


def test_a_write_from_the_page_reaches_the_service(browser, writable):
    open_page(browser, writable)
    browser.find_element(By.ID, "write-path").send_keys("serve.browser.level")
    browser.find_element(By.ID, "write-value").send_keys("8.75")
    browser.find_element(By.CSS_SELECTOR, "#write button").click()
    wait(browser, lambda d: d.find_element(By.ID, "write-result").text.startswith("wrote"))
    assert kvtag("read", "serve.browser.level").split("\t")[2] == "8.75"
    browser.find_element(By.ID, "write-value").clear()
    browser.find_element(By.ID, "write-value").send_keys("many")
    browser.find_element(By.CSS_SELECTOR, "#write button").click()
    wait(browser, lambda d: "'many' is not a value of type double" in
         d.find_element(By.ID, "error").text)
