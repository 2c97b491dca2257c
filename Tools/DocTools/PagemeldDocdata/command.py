"""The command line."""
import argparse
import glob
import os
import re
import sys

from docdata_files import make_missing_sets
from documentation_set import SetOptions, make_docdata, remove_page_script
from messages import PROGRAM, say

SET_NAMES = ("Manual", "ScriptReference")
HERE = os.path.dirname(os.path.realpath(__file__))
# Where the program is installed, and in the sources.
VERSION_FILES = (os.path.join(HERE, "version"), os.path.join(HERE, "..", "..", "..", "CMakeLists.txt"))


def read_version():
    with open(next(filter(os.path.exists, VERSION_FILES)), encoding="utf-8") as file:
        return re.search(r"\d+\.\d+\.\d+", file.read())[0]


class ShowVersion(argparse.Action):
    def __call__(self, parser, namespace, values, option_string=None):
        print(PROGRAM, read_version())
        parser.exit()


def add_page_options(add):
    add("--page-script", action="store_true", help="put the page script into every page and into docdata")
    add("--remove", action="store_true", help="take the page script out again, and do nothing else")
    add("--exclude", metavar="PATTERN", action="append", default=[],
        help="leave out pages whose path in the set matches; may be repeated")


def add_contents_options(add):
    add("--toc", metavar="PAGE", action="append", default=[],
        help="take the contents from the lists in this page of each set; may be repeated")
    add("--share", metavar="GROUP", action="append", default=[],
        help="join this group without a page with that of other modules; may be repeated")
    add("--title", metavar="TITLE", default="", help="name of the module in the contents; default: of its start page")
    add("--root-title", metavar="TITLE", default="",
        help="title of all contents; default: the name of the set directory")
    add("--root-link", metavar="PAGE", default="index.html", help="start page of each set; default: %(default)s")


def add_general_options(add):
    add("--jobs", metavar="NUMBER", type=int, default=len(os.sched_getaffinity(0)),
        help="processes; default: the processors")
    add("--version", nargs=0, action=ShowVersion, help="show the version")


def make_parser():
    parser = argparse.ArgumentParser(
        prog=PROGRAM, usage="%(prog)s [OPTION]... SET_DIRECTORY...",
        description="Makes docdata/index.json and docdata/toc.json of documentation sets from their HTML pages.",
        epilog="A set directory is called Manual or ScriptReference and lies in the directory of its module.")
    parser.add_argument("set_directories", metavar="SET_DIRECTORY", nargs="+", help=argparse.SUPPRESS)
    for add_options in (add_page_options, add_contents_options, add_general_options):
        add_options(parser.add_argument)
    return parser


def find_mistake(directory):
    """Returns what is wrong with the argument for a set directory, or None."""
    if not os.path.isdir(directory):
        return f"{directory} is not a directory"
    if os.path.basename(os.path.abspath(directory)) in SET_NAMES:
        return None
    for kind, levels in (("a module", ()), ("a directory of modules", ("*",))):
        sets = [os.path.join(directory, *levels, name) for name in SET_NAMES
                if glob.glob(os.path.join(glob.escape(directory), *levels, name))]
        if sets:
            return f"{directory} is {kind}, not a set directory; the call is {PROGRAM} {' '.join(sets)}"
    return f"{directory} is not a set directory: that must be called Manual or ScriptReference"


def check(parser, arguments):
    """Ends the program if the arguments can't be meant so."""
    for directory in arguments.set_directories:
        mistake = find_mistake(directory)
        if mistake:
            parser.error(mistake)
    modules = {os.path.dirname(os.path.abspath(directory)) for directory in arguments.set_directories}
    if arguments.title and len(modules) > 1:
        parser.error("--title names one module, but the sets belong to several")
    if arguments.page_script and arguments.remove:
        parser.error("--page-script and --remove exclude each other")


def work_on_set(work, directory, options):
    """Does the work on a set directory. Returns whether it could be done, and says why not. A set without pages that
    has docdata is there for the outputs, since all modules need the same sets."""
    if work(os.path.abspath(directory), options):
        return True
    if os.path.isdir(os.path.join(directory, "docdata")):
        say(f"{directory}: no pages, docdata for outputs only")
        return True
    say(f"error: {directory} has no pages")
    return False


def succeeds(act, *arguments):
    """Returns whether act(*arguments) neither returned False nor failed to read or write a file, which is said."""
    try:
        return act(*arguments) is not False
    except OSError as error:
        say(f"error: {error}")
        return False


def main():
    parser = make_parser()
    arguments = parser.parse_args()
    check(parser, arguments)
    options = SetOptions(arguments.root_link, arguments.root_title, arguments.title, arguments.toc, arguments.share,
                         arguments.exclude, arguments.page_script, max(arguments.jobs, 1))
    work = remove_page_script if arguments.remove else make_docdata
    results = [succeeds(work_on_set, work, directory, options) for directory in arguments.set_directories]
    if not arguments.remove:
        results.append(succeeds(make_missing_sets, arguments.set_directories))
    sys.exit(0 if all(results) else 1)
