"""Makes what the fuzz targets start from: seeds.py SCHEMA EVERYTHING FOLDER

FOLDER/xml.dict    the names and literals of the schema, and what XML itself is made of
FOLDER/parts/      the document of every element and attribute, cut into documents of a few kilobytes: a fuzzer learns
                   little from a long input, and a load that ends early never sees what stands far behind
"""

import copy
import pathlib
import sys
import xml.etree.ElementTree as ElementTree

FORMAT = "http://hqf.example/v2"
SCHEMA = "{http://www.w3.org/2001/XMLSchema}"
LARGEST_PART = 3000
SMALL = 400

SYNTAX = [
    "<!--", "-->", "<![CDATA[", "]]>", "<?p ", "?>", "<!DOCTYPE Hqf:Hqf [", "]>", '<!ENTITY e "v">', '<!ENTITY % p "v">',
    "&e;", "%p;", "&amp;", "&lt;", "&#65;", "&#x1D11E;", "&#13;", "<x:a xmlns:x=\"u\">", "</x:a>", "<x/>", "/>", "></",
    ' xsi:nil="true"', ' xsi:type="Hqf:', ' xmlns:Hqf="http://hqf.example/v2"', ' xmlns="http://hqf.example/v2"',
    ' xmlns:xsi="http://www.w3.org/2001/XMLSchema-instance"', '<?xml version="1.0" encoding="', "UTF-16", "ISO-8859-1",
    "US-ASCII", "ISO-10646-UCS-2", "\xFF\xFE", "\xFE\xFF", "\xEF\xBB\xBF", "\xC2\x85", "\xE2\x80\xA8", "\xED\xA0\x80",
    "\r\n", "NaN", "-INF", "-0.0", "1e-5", "2024-05-01T09:00:00Z", "2024-02-29T23:59:59.5+05:30", "QUJD", "4294967296",
]


def dictionary_row(text):
    return '"' + "".join(c if " " <= c <= "~" and c not in '"\\' else f"\\x{ord(c):02X}" for c in text) + '"\n'


def dictionary(schema):
    names = {}
    for node in ElementTree.parse(schema).iter():
        if node.tag == SCHEMA + "element" and "name" in node.attrib:
            names["<Hqf:" + node.attrib["name"] + ">"] = None
            names["</Hqf:" + node.attrib["name"] + ">"] = None
        elif node.tag == SCHEMA + "attribute" and "name" in node.attrib:
            names[" " + node.attrib["name"] + '="'] = None
        elif node.tag == SCHEMA + "enumeration":
            names[node.attrib["value"]] = None
    return "".join(map(dictionary_row, SYNTAX + list(names)))


def size(element):
    return len(ElementTree.tostring(element))


def parts(element):
    """The element itself if it is small, else copies of it with one large child each, among the first small ones of
    each name: most of what is mandatory is small."""
    if size(element) <= LARGEST_PART:
        yield element
        return
    small = {}
    for child in element:
        if size(child) < SMALL:
            small.setdefault(child.tag, child)
    company = list(small.values())
    for child in element:
        if child in company:
            continue
        for part in parts(child):
            less = copy.copy(element)
            less[:] = [part if other is child else other for other in element
                       if other is child or (other in company and other.tag != child.tag)]
            yield less


def documents(everything):
    ElementTree.register_namespace("Hqf", FORMAT)
    root = ElementTree.parse(everything).getroot()
    preamble, *content = root
    header, *owner_and_version = preamble
    short_header = copy.copy(header)
    mandatory = ("Creator", "CreatorVersion", "ChangeHistory", "Purpose")
    short_header[:] = [child for child in header if child.tag.split("}")[1] in mandatory]
    short_preamble = copy.copy(preamble)
    short_preamble[:] = [short_header]
    for part in parts(header):
        yield [[part]], []
    for child in owner_and_version:
        for part in parts(child):
            yield [[short_header, part]], []
    for element in content:
        for part in parts(element):
            yield [[short_header]], [part]


def main(schema, everything, folder):
    folder = pathlib.Path(folder)
    folder.joinpath("parts").mkdir(parents=True, exist_ok=True)
    folder.joinpath("xml.dict").write_text(dictionary(schema), encoding="ascii")
    for number, (preambles, content) in enumerate(documents(everything)):
        root = ElementTree.Element(f"{{{FORMAT}}}Hqf")
        for children in preambles:
            ElementTree.SubElement(root, f"{{{FORMAT}}}Preamble").extend(children)
        root.extend(content)
        text = ElementTree.tostring(root, encoding="UTF-8", xml_declaration=True)
        folder.joinpath("parts", f"{number:03}.hqf").write_bytes(text)


if __name__ == "__main__":
    main(*sys.argv[1:])
