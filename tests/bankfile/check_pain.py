#!/usr/bin/env python3
# SPDX-License-Identifier: MIT
"""Proves a credit transfer file: check_pain.py FILE

Written from the published structure of pain.001.001.03 and .09 and the rules of the SEPA credit
transfer, and not from the program that writes such files: order and number of the elements, their
lengths and patterns, sums and counts, account numbers, references that are given once. Prints what
is wrong, a line each; a right file gives its transfers as a table and the status 0.
"""
import re
import sys
import xml.etree.ElementTree as tree
from collections import Counter
from decimal import Decimal

NAMESPACE = "urn:iso:std:iso:20022:tech:xsd:pain.001.001."
LETTERS = r"[a-zA-Z0-9/\-?:().,'+ ]"
DATE = r"\d{4}-\d\d-\d\d"
BIC = r"[A-Z0-9]{4}[A-Z]{2}[A-Z0-9]{2}([A-Z0-9]{3})?"


def text(most, pattern=LETTERS + "+"):
    """A field of letters that every bank takes, between 1 and so many."""
    return lambda value: 1 <= len(value) <= most and re.fullmatch(pattern, value) \
        and value == value.strip() and not value.startswith("/") and not value.endswith("/") \
        and "//" not in value


def like(pattern):
    return lambda value: re.fullmatch(pattern, value)


def iban(value):
    """The check digits: letters as numbers from 10, the first four behind the others."""
    if not re.fullmatch(r"[A-Z]{2}\d{2}[A-Z0-9]{11,30}", value):
        return False
    if value.startswith("PT") and (len(value) != 25 or int(value[4:]) % 97 != 1):
        return False
    return int("".join(str(int(letter, 36)) for letter in value[4:] + value[:4])) % 97 == 1


def amount(value):
    return re.fullmatch(r"\d{1,9}\.\d{2}", value) and Decimal(value) >= Decimal("0.01")


def forms(version):
    """What each element holds: the elements in their order ("?": may lack, "*": one or more), or
    how its text has to look."""
    new = version == "09"
    day = {"ReqdExctnDt": ["Dt"], "Dt": like(DATE)} if new else {"ReqdExctnDt": like(DATE)}
    bic = "BICFI" if new else "BIC"
    return {
        "Document": ["CstmrCdtTrfInitn"],
        "CstmrCdtTrfInitn": ["GrpHdr", "PmtInf"],
        "GrpHdr": ["MsgId", "CreDtTm", "NbOfTxs", "CtrlSum", "InitgPty"],
        "MsgId": text(35), "PmtInfId": text(35),
        "CreDtTm": like(DATE + r"T\d\d:\d\d:\d\d"),
        "NbOfTxs": like(r"[1-9]\d{0,14}"),
        "CtrlSum": like(r"\d{1,16}\.\d{2}"),
        "InitgPty": ["Nm", "Id"],
        "PmtInf": ["PmtInfId", "PmtMtd", "BtchBookg", "NbOfTxs", "CtrlSum", "PmtTpInf",
                   "ReqdExctnDt", "Dbtr", "DbtrAcct", "DbtrAgt", "ChrgBr", "CdtTrfTxInf*"],
        "PmtMtd": like("TRF"), "BtchBookg": like("true|false"), "ChrgBr": like("SLEV"),
        "PmtTpInf": ["SvcLvl"], "SvcLvl": ["Cd"], "Cd": like("SEPA"),
        **day,
        "Dbtr": ["Nm", "Id"], "Dbtr/Id": ["OrgId"], "InitgPty/Id": ["OrgId"],
        "OrgId": ["Othr"], "Othr": ["Id"], "Othr/Id": text(35),
        "DbtrAcct": ["Id"], "CdtrAcct": ["Id"], "DbtrAcct/Id": ["IBAN"], "CdtrAcct/Id": ["IBAN"],
        "IBAN": iban,
        "DbtrAgt": ["FinInstnId"], "FinInstnId": [bic + "?", "Othr?"], bic: like(BIC),
        "CdtTrfTxInf": ["PmtId", "Amt", "Cdtr", "CdtrAcct", "RmtInf"],
        "PmtId": ["EndToEndId"], "EndToEndId": text(35),
        "Amt": ["InstdAmt"], "InstdAmt": amount,
        "Cdtr": ["Nm"], "Nm": text(70),
        "RmtInf": ["Ustrd"], "Ustrd": text(140),
    }


class Check:
    def __init__(self, version):
        self.space = "{" + NAMESPACE + version + "}"
        self.forms = forms(version)
        self.faults = []

    def local(self, element):
        if not element.tag.startswith(self.space):
            self.faults.append(f"{element.tag}: another namespace")
        return element.tag.removeprefix(self.space)

    def prove(self, element, parent=""):
        name = self.local(element)
        form = self.forms.get(f"{parent}/{name}", self.forms.get(name))
        allowed = {"Ccy": "EUR"} if name == "InstdAmt" else {}
        if dict(element.attrib) != allowed:
            self.faults.append(f"{name}: attributes {element.attrib}")
        if form is None:
            self.faults.append(f"{name}: unknown")
        elif callable(form):
            if len(element) or not form(element.text or ""):
                self.faults.append(f"{name}: «{element.text}»")
        else:
            self.prove_order(element, name, form)
            for child in element:
                self.prove(child, name)

    def prove_order(self, element, name, form):
        """The children against the list, which a regular expression over their names stands for."""
        found = "".join(self.local(child) + " " for child in element)
        ends = {"?": "?", "*": "+"}
        wanted = "".join(f"({each.rstrip('?*')} ){ends.get(each[-1], '')}" for each in form)
        if not found or not re.fullmatch(wanted, found) or (element.text or "").strip():
            self.faults.append(f"{name}: {found[:200]}")

    def at(self, element, path):
        return [each.text or "" for each in
                element.findall("/".join(self.space + step for step in path.split("/")))]

    def prove_sums(self, root):
        payments = root.findall(f".//{self.space}CdtTrfTxInf")
        total = sum((Decimal(self.at(each, "Amt/InstdAmt")[0]) for each in payments), Decimal())
        for part in root.findall(f".//{self.space}GrpHdr") + root.findall(f".//{self.space}PmtInf"):
            if int(self.at(part, "NbOfTxs")[0]) != len(payments):
                self.faults.append(f"NbOfTxs: not {len(payments)}")
            if Decimal(self.at(part, "CtrlSum")[0]) != total:
                self.faults.append(f"CtrlSum: not {total}")
        references = [self.at(each, "PmtId/EndToEndId")[0] for each in payments]
        self.faults += [f"EndToEndId: «{reference}» {times} times"
                        for reference, times in Counter(references).items() if times > 1]
        return [(references[at], self.at(each, "Amt/InstdAmt")[0], self.at(each, "Cdtr/Nm")[0],
                 self.at(each, "CdtrAcct/Id/IBAN")[0]) for at, each in enumerate(payments)]


def main(path):
    with open(path, "rb") as source:
        content = source.read()
    if b"<!" in content:
        print("a declaration of its own")
        return 1
    try:
        root = tree.fromstring(content)
    except tree.ParseError as error:
        print(f"not well formed: {error}")
        return 1
    version = root.tag.removeprefix("{" + NAMESPACE).split("}")[0]
    if version not in ("03", "09") or not root.tag.endswith("}Document"):
        print(f"no file of that kind: {root.tag}")
        return 1
    check = Check(version)
    check.prove(root)
    transfers = check.prove_sums(root) if not check.faults else []
    if check.faults:
        print(*check.faults, sep="\n")
        return 1
    print(version, len(transfers))
    for transfer in transfers:
        print(*transfer, sep="|")
    return 0


if __name__ == "__main__":
    sys.exit(main(sys.argv[1]))
