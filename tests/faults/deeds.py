# SPDX-License-Identifier: MIT
"""Every operation that writes to a book, and the order in which it writes."""

from dataclasses import dataclass, field

ACCOUNT = ("tbZelmar_Movimentos", "tbSocios_Acumulados")
REGISTERED = "tbOperacoes+1 tbZelmar_Movimentos+1"
NUMBERED = "tbContadores~"


@dataclass
class Deed:
    name: str
    line: str = ""  # for the program of deeds, or several after each other, or
    command: list = field(default_factory=list)  # for the program itself
    presses: list = field(default_factory=list)  # that follow on the same screen
    order: list = None  # what each write does; None where it is one of very many
    tables: tuple = ACCOUNT  # in which what it leaves is looked for
    whole: bool = False  # all of it or nothing
    files: dict = field(default_factory=dict)  # that lie outside of the folder
    before: list = field(default_factory=list)  # a command that goes before,
    then: str = ""  # and what happens to the book after that
    schema: str = ""  # an older one, in which the book is made
    many: int = 1  # pictures wanted, as a multiple of those of other deeds; a day's work is then
    # finished, and not done again
    empty: bool = False  # there is no book yet
    repair: list = field(default_factory=list)  # commands that come before a second run, if needed
    file: str = "zelmars.db"  # that it writes
    checked: str = "sqlite:{folder}/zelmars"


def annulment(name, key):
    return Deed(name, f"annul {key}", presses=["again"], order=[
        "tbOperacoes+1 tbZelmar_Movimentos~", NUMBERED, "tbOperacoes~ tbZelmar_Movimentos+1",
        "tbOperacoes~ tbSocios_Acumulados~"])


def imported(kind, tables, text):
    return Deed("import of " + kind, command=["import", kind, "{own}/rows.csv"], tables=tables,
                files={"rows.csv": text}, whole=True)


BOOK = "sqlite:{folder}/zelmars"
BACKUP = ["backup", "--book", BOOK, "{folder}/copia"]
# As the manual says of a close that stopped.
RESTORE = [["restore", "--book", BOOK, "--replace", "{folder}/copia"]]

DEEDS = [
    Deed("posting", "posting D1", presses=["again"],
         order=[NUMBERED, REGISTERED, "tbOperacoes-1 tbSocios_Acumulados~"]),
    Deed("bill", "bill D1", presses=["again"],
         order=["tbCheques~", NUMBERED, REGISTERED, "tbOperacoes-1 tbSocios_Acumulados~"]),
    Deed("receipt", "receipt", presses=["again"],
         order=[NUMBERED, REGISTERED, "tbOperacoes-1 tbSocios_Acumulados+1"]),
    Deed("correction", "correction", presses=["again"],
         order=[NUMBERED, REGISTERED, "tbOperacoes-1 tbSocios_Acumulados~"]),
    annulment("annulment of a document", 901),
    annulment("annulment of a bill", 902),
    annulment("annulment of a receipt", 903),
    Deed("new hospital", "hospital new", order=["tbHospitais+1"], tables=("tbHospitais",)),
    Deed("change of a hospital", "hospital change", order=["tbHospitais~"],
         tables=("tbHospitais",)),
    Deed("end of a hospital", "hospital delete", order=["tbHospitais-1"], tables=("tbHospitais",)),
    Deed("new rubric", "rubric new", order=["tbZelmar_Plafonds+1"], tables=("tbZelmar_Plafonds",)),
    Deed("change of a rubric", "rubric change", order=["tbZelmar_Plafonds~"],
         tables=("tbZelmar_Plafonds",)),
    Deed("end of a rubric", "rubric delete", order=["tbZelmar_Plafonds-1"],
         tables=("tbZelmar_Plafonds",)),
    Deed("maintenance", "maintenance"),
    Deed("close", "close 2025", before=BACKUP, repair=RESTORE,
         tables=(*ACCOUNT, "tbZelmar_Movimentos_Historico", "tbContadores")),
    imported("members", ("tbSocios",),
             "Número KOR;Nome;NIB;Inscrito\n100003;Eva;;sim\n100001;Ana Sá;;sim\n"),
    imported("relatives", ("tbSocios_Familias",),
             "Número KOR;Código;Nome\n100001;B;João\n100002;C1;Rita\n"),
    imported("premiums", ("tbQuotas_Socios",),
             "Número KOR;Último ano;Último mês;Total devido;Total pago\n100001;2026;7;120;84,5\n"),
    imported("rubrics", ("tbZelmar_Plafonds",),
             "Grupo;Código;Descrição;Percentagem;Sócio\n;90;Outra;;300\n90;90.01;Nova;0,6;200\n"),
    imported("hospitals", ("tbHospitais",), "Código;Nome\nH01;Hospital da Luz\nH90;Outro\n"),
    Deed("copy", command=["copy", BOOK, "sqlite:{folder}/copia"], whole=True, file="copia.db",
         checked="sqlite:{folder}/copia"),
    Deed("backup", command=BACKUP, whole=True, file="copia"),
    Deed("restore", command=RESTORE[0], before=BACKUP, then="DELETE FROM tbZelmar_Movimentos;",
         whole=True),
    Deed("new book", command=["init", "{folder}"], empty=True, whole=True,
         tables=("tbSocios", "tbVersao", "tbZelmar_movimentos_tipos")),
    Deed("upgrade", command=["upgrade", "--book", BOOK], schema="../database/first/sqlite.sql",
         whole=True,
         tables=("tbSocios", "tbVersao", *ACCOUNT)),
    Deed("day", "\n".join(f"posting D{number}\nreceipt\nbill B{number}" for number in range(1, 61)),
         many=36),
]
