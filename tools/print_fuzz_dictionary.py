#!/usr/bin/env python3
"""Prints the dictionary that the fuzz targets for documents use: every name of the tag table and some XML around it."""
import os
import re

TABLE = "kestrel/translate/PMMLModelTags.inc"
XML = ["<?xml version=\"1.0\"?>", "<![CDATA[", "]]>", "<!--", "-->", "<!DOCTYPE", "<!ENTITY", "&#", "&amp;", "/>", "</", "=\"",
       "xmlns=", "encoding=\"UTF-16\""]


def entry(text):
    return '"' + re.sub(r'[^ !#-\[\]-~]', lambda c: "".join(f"\\x{byte:02X}" for byte in c[0].encode()), text) + '"'


def main():
    os.chdir(os.path.join(os.path.dirname(os.path.abspath(__file__)), ".."))
    with open(TABLE, encoding="utf-8") as table:
        names = re.findall(r'^KESTREL_TAG\(\w+, "((?:[^"\\]|\\.)*)"\)', table.read(), re.M)
    texts = {name.replace('\\"', '"').replace("\\\\", "\\") for name in names}
    print("\n".join(entry(text) for text in XML + sorted(texts) if text))


if __name__ == "__main__":
    main()
