"""How an import recognises number-format codes and shows numbers by them."""
import calendar
import datetime as dt
import math
import re

PATTERNS = dict(line.split("=") for line in """
m/d=M/d|d/m=d/M|m/d/yy=M/d/yy|mm/dd/yy=MM/dd/yy|d/m/yy=d/M/yy|dd/mm/yy=dd/MM/yy|d-mmm=d-MMM
d-mmm-yy=d-MMM-yy|dd-mmm-yy=dd-MMM-yy|mmm-yy=MMM-yy|mmmm-yy=MMMM-yy|mmmm d, yyyy=MMMM d, yyyy
m/d/yy h:mm AM/PM=M/d/yy h:mm a|m/d/yy h:mm=M/d/yy H:mm|mmmmm=MMMMM|mmmmm-yy=MMMMM-yy
m/d/yyyy=M/d/yyyy|d/m/yyyy=d/M/yyyy|d-mmm-yyyy=d-MMM-yyyy|dddd, mmmm dd, yyyy=EEEE, MMMM dd, yyyy
h:mm=H:mm|h:mm AM/PM=h:mm a|h:mm:ss=H:mm:ss|h:mm:ss.000=H:mm:ss.SSS|h:mm:ss AM/PM=h:mm:ss a
h:mm:ss.000 AM/PM=h:mm:ss.SSS a|mm:ss.0=mm:ss.S|mm:ss=mm:ss
""".strip().replace("\n", "|").split("|"))
UNKNOWN_PATTERN = "MMM d, yyyy"  # of a date code that is none of these

_MONEY = '"$"#,##0%s_);%s\\("$"#,##0%s\\)'
_BARE = "#,##0%s_);%s\\(#,##0%s\\)"
_LEDGER = '_(%s* #,##0%s_);_(%s* \\(#,##0%s\\);%s_(%s* "-"%s_);_(@_)'
BUILT_IN = {
    1: "0", 2: "0.00", 3: "#,##0", 4: "#,##0.00", 9: "0%", 10: "0.00%", 11: "0.00E+00",
    48: "0.00E+00", 14: "m/d/yy", 15: "d-mmm-yy", 16: "d-mmm", 17: "mmm-yy", 18: "h:mm AM/PM",
    19: "h:mm:ss AM/PM", 20: "h:mm", 21: "h:mm:ss", 22: "m/d/yy h:mm:ss", 45: "mm:ss",
    46: "[h]:mm:ss", 47: "mm:ss",
    5: _MONEY % ("", "", ""), 6: _MONEY % ("", "[Red]", ""), 7: _MONEY % (".00", "", ".00"),
    8: _MONEY % (".00", "[Red]", ".00"), 37: _BARE % ("", "", ""), 38: _BARE % ("", "[Red]", ""),
    39: _BARE % (".00", "", ".00"), 40: _BARE % (".00", "[Red]", ".00"),
    41: _LEDGER % ('"$"', "", '"$"', "", "", '"$"', ""), 42: _LEDGER % ("", "", "", "", "", "", ""),
    43: _LEDGER % ('"$"', ".00", '"$"', ".00", "", '"$"', "??"),
    44: _LEDGER % ('"$"', ".00", '"$"', ".00", " ", '"$"', "??")}
BUILT_IN_DATES = {*range(14, 23), 45, 46, 47}
DESCRIBED = {
    "General Date": ("m/d/yyyy h:mm", True), "Long Date": ("d-mmm-yy", True),
    "Medium Date": ("d-mmm-yy", True), "Short Date": ("m/d/yy", True),
    "Long Time": ("h:mm:ss AM/PM", True), "Medium Time": ("h:mm AM/PM", True),
    "Short Time": ("h:mm", True), "Percent": ("0.00%", False),
    "Currency": (_MONEY % (".00", "[Red]", ".00"), False),
    "Scientific": ("0.00E+00", False), "Fixed": ("0.00", False)}

_DECIMAL = re.compile(r"(?:(?:#,##)?0(?:\.(0*))?)?\Z")


def _is_scientific(code):
    return re.fullmatch(r"(?:##)?(?:#,##)?0(?:\.0*)?E\+00?", code) is not None


def _is_percent(code):
    return code.endswith("%") and _DECIMAL.match(code[:-1]) is not None


def _is_currency(code):
    section = code.replace("\\", "").split(";")[0]
    return "#,##0" in section and ("[$" in section or section.count('"') >= 2)


def style(code):
    """(code, is date-time) of a format code that a file brings along."""
    if code in DESCRIBED:
        return DESCRIBED[code]
    if _is_scientific(code) or _is_percent(code) or _is_currency(code):
        return code, False
    clean = code.replace("\\", "")
    if "[$" in clean and "]" in clean[clean.index("[$"):]:
        clean = clean[clean.index("]", clean.index("[$")) + 1:]
    clean = clean.split(";")[0]
    if re.search(r"\[.*s\.", clean):
        raise ValueError(f"{code}: elapsed times with fractions are not expected here")
    # "Q" counts doubled and "W" before "k" or "w"; nothing else in upper case does.
    is_date = re.search(r"[dyhms]|[Qq][Qq](?<!QQ)(?<!qq)|W[kw]", clean) is not None
    return (clean, True) if is_date else (code, False)


def built_in(number):
    """(code, is date-time) of a built-in format, None for one that an import does not know."""
    return (BUILT_IN[number], number in BUILT_IN_DATES) if number in BUILT_IN else None


def precision(value):
    return next((p for p in range(14, 18) if float("%.*g" % (p, value)) == value), 17)


def show_date(value, pattern):
    """`value`, a serial day number, by an ICU pattern in American English."""
    shifted = value - 25569 + (1 if value < 61 else 0)
    moment = math.floor(shifted * 86400000 + 0.5)
    time = dt.datetime(1970, 1, 1) + dt.timedelta(milliseconds=moment)
    month, day = calendar.month_name[time.month], calendar.day_name[time.weekday()]
    fields = {
        "M": time.month, "MM": f"{time.month:02}", "MMM": month[:3], "MMMM": month,
        "MMMMM": month[0], "d": time.day, "dd": f"{time.day:02}", "yy": f"{time.year % 100:02}",
        "yyyy": f"{time.year:04}", "EEEE": day, "H": time.hour, "h": (time.hour + 11) % 12 + 1,
        "mm": f"{time.minute:02}", "ss": f"{time.second:02}", "a": "AM" if time.hour < 12 else "PM",
        "S": time.microsecond // 100000, "SSS": f"{time.microsecond // 1000:03}"}
    return re.sub(r"([A-Za-z])\1*", lambda run: str(fields[run[0]]), pattern)


def show(value, known):
    """`value` as the format of a style shows it; `known` is (code, is date-time) or None."""
    code, is_date = known or (None, False)
    if is_date:
        return show_date(value, PATTERNS.get(code.replace("\\", ""), UNKNOWN_PATTERN))
    value = value + 0.0 if value else 0.0
    if code is not None and not _is_currency(code):
        if decimal := _DECIMAL.match(code):
            return "%.*f" % (len(decimal[1] or ""), value)
        if _is_percent(code):
            body = code[:-1]
            places = len(body.split(".")[1]) if "." in body else 0 if body == "0" else 2
            return "%.*f%%" % (places, value * 100)
        if _is_scientific(code):
            return scientific(value, code)
    return "%.*g" % (precision(value), value)


def scientific(value, code):
    places = re.search(r"\.(0*)E", code)
    places = len(places[1]) if places else 2
    mantissa, exponent = ("%.*E" % (places or precision(value) - 1, value)).split("E")
    if "." in mantissa:
        mantissa = mantissa.rstrip("0").rstrip(".")
    return mantissa + "E" + re.sub(r"^([+-])0(\d\d)$", r"\1\2", exponent)
