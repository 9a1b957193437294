# SPDX-License-Identifier: MIT
"""A host in another language: loads the component through its exported entry points and calls
General through the table of its interface. usage: foreign_host.py LIBRARY SCHEMA"""
import ctypes
import os
import pathlib
import sqlite3
import sys
import tempfile
import uuid

OK, FALSE, FAIL = 0, 1, -0x7FFFBFFB  # statuses; the last is 0x80004005

CLSID_GENERAL = uuid.UUID("ca01cffc-cfd5-45ba-8a33-b5db8fd32e63").bytes_le
IID_GENERAL = uuid.UUID("7862b93e-d483-4374-9451-1136597e36c0").bytes_le
IID_CLASS_FACTORY = uuid.UUID("00000001-0000-0000-c000-000000000046").bytes_le

# Slots: 0-2 QueryInterface, AddRef, Release; then those of each interface.
RELEASE, CREATE_INSTANCE = 2, 3
LAST_ERROR_TEXT, CALL_IRS, LOGIN = 4, 8, 10


def slot(instance, number, result, *types):
    """The function in a slot of an object's table, bound to the object."""
    table = ctypes.cast(instance, ctypes.POINTER(ctypes.POINTER(ctypes.c_void_p)))[0]
    function = ctypes.CFUNCTYPE(result, ctypes.c_void_p, *types)(table[number])
    return lambda *arguments: function(instance, *arguments)


def release(instance):
    return slot(instance, RELEASE, ctypes.c_uint32)()


def create_general(library):
    factory, general = ctypes.c_void_p(), ctypes.c_void_p()
    entry = library.DllGetClassObject
    entry.restype = ctypes.c_int32
    assert entry(CLSID_GENERAL, IID_CLASS_FACTORY, ctypes.byref(factory)) == OK
    create = slot(factory, CREATE_INSTANCE, ctypes.c_int32, ctypes.c_void_p, ctypes.c_char_p,
                  ctypes.c_void_p)
    assert create(None, IID_GENERAL, ctypes.byref(general)) == OK
    assert release(factory) == 0
    return general


def login(general):
    """The status of Login, its result and the text of a failure."""
    result = ctypes.c_bool(False)
    call = slot(general, LOGIN, ctypes.c_int32, *[ctypes.c_void_p] * 6)
    status = call(None, None, None, None, None, ctypes.byref(result))
    text = slot(general, LAST_ERROR_TEXT, ctypes.c_char_p)()
    return status, result.value, text.decode()


def write_settings(folder, **values):
    """The values of the machine's hive; readable by their owner only."""
    file = folder / "HKEY_LOCAL_MACHINE.ini"
    lines = [f'Norvanta\\Corvenda\\{name}="{value}"' for name, value in values.items()]
    file.write_text("\n".join(["[SOFTWARE]", *lines, ""]))
    file.chmod(0o600)


def main(library_file, schema_folder):
    with tempfile.TemporaryDirectory() as name:
        folder = pathlib.Path(name)
        os.environ["ZELMARS_REGISTRY"] = name
        with sqlite3.connect(folder / "zelmars.db") as book:
            schema = pathlib.Path(schema_folder)
            movement = (schema / "movement.sql").read_text()
            book.executescript(
                (schema / "book.sql").read_text().replace("{movement}", movement))
        book.close()
        library = ctypes.CDLL(library_file)
        library.DllCanUnloadNow.restype = ctypes.c_int32
        assert library.DllCanUnloadNow() == OK
        general = create_general(library)
        assert library.DllCanUnloadNow() == FALSE

        assert login(general) == (OK, False, ""), "without settings"

        good = dict(dtSecurityInfo="True", dtUser="ana", dtPassword="", dtInitialCatalog="zelmars",
                    dtDataSource=f"sqlite:{folder}")
        write_settings(folder, **good)
        assert login(general) == (OK, True, ""), "with settings"

        write_settings(folder, **{key: good[key] for key in good if key != "dtPassword"})
        assert login(general) == (OK, False, ""), "with one missing"

        write_settings(folder, **{**good, "dtDataSource": f"sqlite:{folder}/nenhures"})
        status, result, text = login(general)
        assert (status, result) == (FAIL, False), "without a book"
        assert "nenhures" in text, text
        assert not (folder / "nenhures").exists()

        # What needs a window says so by its status and leaves the program running.
        write_settings(folder, **good)
        assert slot(general, CALL_IRS, ctypes.c_int32)() == FAIL
        assert slot(general, LAST_ERROR_TEXT, ctypes.c_char_p)().decode().strip()

        assert release(general) == 0
        assert library.DllCanUnloadNow() == OK


main(*sys.argv[1:])
