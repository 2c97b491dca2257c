"""Writes what is in the directory docdata of a set: index, contents, and the page script."""
import json
import os
import shutil

from messages import say

HERE = os.path.dirname(os.path.realpath(__file__))
# Where the program is installed, and in the sources.
WEB_DIRECTORIES = (os.path.join(HERE, "..", "web"), os.path.join(HERE, "..", "..", "..", "web"))


def write_whole(file, write):
    """Writes a file by write(temporary file), so that it is there whole or as it was."""
    write(file + ".tmp")
    os.replace(file + ".tmp", file)


def write_text(file, write):
    """Writes a file of text by write(stream)."""
    def write_temporary(temporary):
        with open(temporary, "w", encoding="utf-8", newline="\n") as stream:
            write(stream)
    write_whole(file, write_temporary)


def write_inputs(docdata, index, contents):
    """Writes index.json and toc.json into the directory docdata, which is made if it is not there."""
    os.makedirs(docdata, exist_ok=True)
    write_text(os.path.join(docdata, "index.json"), index.write)
    write_text(os.path.join(docdata, "toc.json"),
               lambda stream: stream.write(json.dumps(contents, ensure_ascii=False, indent=1) + "\n"))


def list_web_files():
    directory = next(filter(os.path.isdir, WEB_DIRECTORIES))
    return [entry.path for entry in os.scandir(directory) if entry.name.endswith((".js", ".css"))]


def copy_script(docdata):
    """Copies the page script into the directory docdata."""
    for file in list_web_files():
        write_whole(os.path.join(docdata, os.path.basename(file)),
                    lambda temporary, file=file: shutil.copyfile(file, temporary))


def remove_script(docdata):
    """Removes the page script from the directory docdata."""
    for file in list_web_files():
        copy = os.path.join(docdata, os.path.basename(file))
        if os.path.exists(copy):
            os.remove(copy)


def make_missing_sets(directories):
    """Makes docdata for the sets that only some of the modules of the set directories have, since pagemeld writes the
    outputs of a set into every module."""
    paths = [os.path.abspath(directory) for directory in directories]
    modules, names = set(map(os.path.dirname, paths)), set(map(os.path.basename, paths))
    for directory in sorted(os.path.join(module, name) for module in modules for name in names):
        if not os.path.exists(directory):
            os.makedirs(os.path.join(directory, "docdata"))
            say(f"{directory}: made for outputs, since another module has this set")
