"""Loads the workbook and looks at its last cell: libreoffice.py BOOK WORKSHEETS ROWS COLUMNS LAST_CELL

The office is asked over a pipe, since its own commands can only load and then write.
"""
import os
import pathlib
import subprocess
import sys
import time

import uno
from com.sun.star.beans import PropertyValue
from com.sun.star.connection import NoConnectException
from com.sun.star.lang import DisposedException

book, sheet, cell = sys.argv[1], int(sys.argv[2]) - 1, sys.argv[5]
address = f"pipe,name=peer{os.getpid()};urp"
profile = (pathlib.Path.home() / "office").as_uri()
office = subprocess.Popen(["soffice", "--headless", "--norestore", f"-env:UserInstallation={profile}",
                           f"--accept={address}"])
services = uno.getComponentContext().ServiceManager
resolver = services.createInstance("com.sun.star.bridge.UnoUrlResolver")
desktop = None
while desktop is None and office.poll() is None:
    try:
        context = resolver.resolve(f"uno:{address};StarOffice.ComponentContext")
        desktop = context.ServiceManager.createInstance("com.sun.star.frame.Desktop")
    except NoConnectException:
        time.sleep(0.02)
hidden = PropertyValue("Hidden", 0, True, 0)
document = desktop.loadComponentFromURL(pathlib.Path(book).as_uri(), "_blank", 0, (hidden,))
found = document.Sheets.getByIndex(sheet).getCellRangeByName(cell).String
document.close(True)
try:
    desktop.terminate()
except DisposedException:  # it ended before it could answer
    pass
office.wait()
sys.exit(0 if found else 1)
