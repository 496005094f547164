"""Default texts: whether they parse, and the C++ expressions that stand for them."""
import json
import math
import re
import uuid

INTEGERS = {"Integer": (32, True), "Integer8": (8, True), "Integer16": (16, True),
            "Integer64": (64, True), "UnlimitedNatural": (32, False), "UInteger8": (8, False),
            "UInteger16": (16, False), "UInteger64": (64, False)}
BOOLEANS = {"true": "true", "1": "true", "false": "false", "0": "false"}
DYNAMIC = {"UUID": "random", "DateTime": "now"}
REAL = re.compile(r"[+-]?(\d+[.]?\d*|[.]\d+)([eE][+-]?\d+)?")
DATE_TIME = re.compile(r"(\d{4}-\d\d-\d\dT\d\d:\d\d:\d\d|\d{8}T\d{6})([.,]\d{1,6})?")
SPECIAL_TIMES = {"not-a-date-time": "not_a_date_time", "+infinity": "pos_infin",
                 "-infinity": "neg_infin"}
UNPARSED = "does not parse as"


class NoDefault(Exception):
    """The text is no default of the type."""


def expression(type_name, text):
    """The default as C++, of a primitive type.

    :raises NoDefault: if the text does not parse.
    """
    if type_name in INTEGERS:
        return integer(text, *INTEGERS[type_name])
    parse = {"Boolean": boolean, "Real": real, "UUID": uuid_bytes, "DateTime": date_time,
             "String": wide_text, "StdString": narrow_text}.get(type_name)
    if parse is None:
        raise NoDefault(f"{type_name} has no text form")
    return parse(text)


def integer(text, bits, signed):
    if not re.fullmatch(r"[+-]?\d+", text):
        raise NoDefault(UNPARSED)
    value = int(text)
    high = 2 ** (bits - signed) - 1
    low = -high - 1 if signed else (0 if bits == 8 else -high)
    if not low <= value <= high:
        raise NoDefault(UNPARSED)
    if not signed:
        return f"{value % 2 ** bits}" + ("u" if bits == 32 else "ul" if bits == 64 else "")
    if value == low and bits >= 32:
        return f"{value + 1} - 1"
    return str(value)


def boolean(text):
    if text not in BOOLEANS:
        raise NoDefault(UNPARSED)
    return BOOLEANS[text]


def real(text):
    """A point, or for older documents a comma or a slash, parts the decimals."""
    plain = re.sub("[,/]", ".", text, count=1)
    if not REAL.fullmatch(plain):
        raise NoDefault(UNPARSED)
    value = float(plain)
    if math.isinf(value):
        raise NoDefault(UNPARSED)
    return repr(value)


def uuid_bytes(text):
    if text == DYNAMIC["UUID"]:
        return "tarn::kiln::ElementImpl::generateNewUuid()"
    if not re.fullmatch(r"[0-9a-fA-F]{8}(-[0-9a-fA-F]{4}){3}-[0-9a-fA-F]{12}", text):
        raise NoDefault(UNPARSED)
    numbers = [f"0x{byte:02x}" for byte in uuid.UUID(text).bytes]
    halves = [", ".join(numbers[:8]), ", ".join(numbers[8:])]
    return "UUID{{" + (",\n" + " " * 8).join(halves) + "}}"


def date_time(text):
    if text == DYNAMIC["DateTime"]:
        return "boost::posix_time::second_clock::local_time()"
    if text in SPECIAL_TIMES:
        return f"boost::posix_time::ptime(boost::posix_time::{SPECIAL_TIMES[text]})"
    if not DATE_TIME.fullmatch(text):
        raise NoDefault(UNPARSED)
    return f'boost::posix_time::from_iso_string("{re.sub("[-:]", "", text)}")'


def wide_text(text):
    return "u" + narrow_text(text)


def narrow_text(text):
    """A literal; what JSON escapes by a number C++ takes as an octal one."""
    quoted = json.dumps(text, ensure_ascii=False)
    return re.sub(r"(?<!\\)((?:\\\\)*)\\u00([0-9a-f]{2})",
                  lambda found: f"{found[1]}\\{int(found[2], 16):03o}", quoted)
