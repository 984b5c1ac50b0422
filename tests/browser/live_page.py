"""The live dialog in headless Chromium: a user clicks, types and picks; the page shows what the
server answers, the settings file holds it, and changes made with the command line show by
themselves. Run by tests/browser/run.sh, which starts the server.

Usage: live_page.py URL BINARY SETTINGS ADMIN SCREENSHOTS
"""
import json
import os
import subprocess
import sys
import time

from selenium import webdriver
from selenium.webdriver.chrome.service import Service
from selenium.common.exceptions import TimeoutException, WebDriverException
from selenium.webdriver.common.by import By
from selenium.webdriver.common.keys import Keys
from selenium.webdriver.support.ui import WebDriverWait

URL, BINARY, SETTINGS, ADMIN, SHOTS = sys.argv[1:6]
WAIT = 5  # seconds any answer may take to show


def stored(repository, attribute):
    with open(SETTINGS, encoding="utf-8") as f:
        entry = json.load(f)["settings"][repository][attribute]
    return entry.get("int", entry.get("double"))


def cli(*args):
    subprocess.run([BINARY, "--settings", SETTINGS, "--admin", ADMIN, *args], check=True,
                   stdout=subprocess.DEVNULL)


def control(driver, page, name):
    return driver.find_element(By.CSS_SELECTOR, f'#page-{page} [data-control="{name}"]')


def classes(driver, page, name):
    return control(driver, page, name).get_attribute("class").split()


def until(driver, what, check):
    def seen(_):
        try:
            return check()
        except WebDriverException:  # an element of a section drawn anew meanwhile
            return False
    try:
        WebDriverWait(driver, WAIT, poll_frequency=0.05).until(seen)
    except TimeoutException:
        raise AssertionError(f"not seen within {WAIT} s: {what}") from None


def shot(driver, name):
    path = os.path.join(SHOTS, name)
    driver.save_screenshot(path)
    print("screenshot", path)


def main():
    options = webdriver.ChromeOptions()
    options.binary_location = "/usr/bin/chromium"
    for arg in ("--headless=new", "--no-sandbox", "--disable-gpu", "--disable-dev-shm-usage",
                "--window-size=1180,1000"):
        options.add_argument(arg)
    driver = webdriver.Chrome(service=Service("/usr/bin/chromedriver"), options=options)
    try:
        driver.get(URL)
        until(driver, "the first state", lambda: "saved at once" in
              driver.find_element(By.CLASS_NAME, "live-status").text)
        driver.find_element(By.CSS_SELECTOR, 'label[for="tab-grid"]').click()

        # A check box and the controls it enables.
        assert "disabled" in classes(driver, "grid", "editorGridSpacingV")
        control(driver, "grid", "checkAllowDistortions").click()
        until(driver, "the vertical spacing enabled",
              lambda: "disabled" not in classes(driver, "grid", "editorGridSpacingV"))
        assert "on" in classes(driver, "grid", "checkAllowDistortions")
        assert stored("DrwSketcherSpecific", "Drw_settings_AllowDistortions") == [1, 0, 0, 0, 0]
        print("check box: the dependent controls are enabled and the file holds the change")

        # The administrator's lock: refused beside the control, who and where said.
        locked = driver.find_element(By.CSS_SELECTOR, '#page-grid [data-name="checkSnapLock"]')
        assert "locked" in locked.get_attribute("class").split()
        shot(driver, "grid-locked.png")
        control(driver, "grid", "checkSnap").click()
        until(driver, "the refusal", lambda: driver.find_elements(By.CSS_SELECTOR, ".live-bubble.refused"))
        refusal = driver.find_element(By.CSS_SELECTOR, ".live-bubble.refused").text
        assert "Locked by" in refusal and ADMIN in refusal, refusal
        assert "on" not in classes(driver, "grid", "checkSnap")  # still the locked value
        shot(driver, "grid-locked-refused.png")
        print("locked control: refused with", repr(refusal))

        # A spinner: a value typed in place; then one it does not take.
        control(driver, "grid", "editorGridSpacing").click()
        field = driver.find_element(By.CSS_SELECTOR, "input.live-edit")
        field.send_keys(Keys.CONTROL, "a")
        field.send_keys("25mm", Keys.ENTER)
        until(driver, "25 mm shown", lambda: "25" in control(driver, "grid", "editorGridSpacing").text)
        control(driver, "grid", "editorGridSpacing").click()
        field = driver.find_element(By.CSS_SELECTOR, "input.live-edit")
        field.send_keys(Keys.CONTROL, "a")
        field.send_keys("wide", Keys.ENTER)
        until(driver, "the bad value refused", lambda: "not a number" in "".join(
            b.text for b in driver.find_elements(By.CSS_SELECTOR, ".live-bubble.refused")))
        until(driver, "the stored value back", lambda: "25" in control(driver, "grid", "editorGridSpacing").text)

        # The scale range combo switches the range shown.
        control(driver, "grid", "cmbGridRange").click()
        driver.find_elements(By.CSS_SELECTOR, ".live-menu div")[1].click()
        until(driver, "the second range shown", lambda: "25 mm" not in control(driver, "grid", "editorGridSpacing").text
              and "Large" in driver.find_element(By.CSS_SELECTOR, "#page-grid .note").text)
        print("spinner and scale range: typed, refused, switched")

        # Changes made elsewhere: the command line, then the administrator's new lock.
        cli("set", "grid", "checkGrid", "off")
        until(driver, "the command line's change", lambda: "on" not in classes(driver, "grid", "checkGrid"))
        cli("lock", "grid", "checkGrid")
        until(driver, "the new lock", lambda: "locked" in driver.find_element(
            By.CSS_SELECTOR, '#page-grid [data-name="checkGridLock"]').get_attribute("class").split())
        print("changes made elsewhere shown")

        # A group of radio buttons: the first choice, which disables a control that needs another.
        driver.find_element(By.CSS_SELECTOR, 'label[for="tab-administration"]').click()
        group = control(driver, "administration", "frmSelectionOnCurrentAssembly")
        first = group.find_elements(By.CSS_SELECTOR, ".radio")[0]
        chosen = first.text
        first.click()
        until(driver, "the first choice on", lambda: "on" in control(driver, "administration", "frmSelectionOnCurrentAssembly")
              .find_elements(By.CSS_SELECTOR, ".radio")[0].get_attribute("class").split())
        until(driver, "its dependent control disabled",
              lambda: "disabled" in classes(driver, "administration", "chkShowWarningSelectionOutAssembly"))
        shown = subprocess.run([BINARY, "--settings", SETTINGS, "--admin", ADMIN, "get", "administration",
                                "frmSelectionOnCurrentAssembly"], check=True, capture_output=True, text=True)
        assert shown.stdout.strip() == chosen, (shown.stdout, chosen)
        print("radio buttons: chosen, saved, dependent control disabled")

        # A sub-dialog opened from its push button; its controls work the same way.
        driver.find_element(By.CSS_SELECTOR, 'label[for="tab-geometry"]').click()
        control(driver, "geometry", "cstTypesPushButton").click()
        until(driver, "the dialog open", lambda: control(driver, "geometry", "checkCstVisuHori").is_displayed())
        control(driver, "geometry", "checkCstVisuHori").click()
        until(driver, "the dialog's check box off", lambda: "on" not in classes(driver, "geometry", "checkCstVisuHori"))
        assert control(driver, "geometry", "checkCstVisuHori").is_displayed()  # the dialog stays open
        assert stored("DraftingOptions", "DrwGeoCstVisuHori") == 0
        shot(driver, "geometry-dialog.png")
        print("sub-dialog: its check box saved")
    except Exception:
        shot(driver, "failure.png")
        raise
    finally:
        driver.quit()


if __name__ == "__main__":
    main()
