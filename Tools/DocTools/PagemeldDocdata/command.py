"""The command line."""
import argparse
import os

from documentation_set import SetOptions, make_docdata


def make_parser():
    parser = argparse.ArgumentParser(prog="pagemeld-docdata", description="Makes index.json and toc.json from HTML.")
    parser.add_argument("--root-title", metavar="T", default="", help="default: the name of the set directory")
    parser.add_argument("--root-link", metavar="L", default="index.html", help="default: %(default)s")
    parser.add_argument("--title", default="", help="of the module's entry")
    parser.add_argument("--share", metavar="GROUP", action="append", default=[])
    parser.add_argument("--exclude", metavar="PATTERN", action="append", default=[])
    parser.add_argument("--jobs", metavar="N", type=int, default=os.cpu_count())
    parser.add_argument("--toc", metavar="FILE", action="append", default=[],
                        help="page in each set directory whose lists are contents; several are allowed")
    parser.add_argument("set_directories", metavar="SET_DIRECTORY", nargs="+")
    return parser


def main():
    parser = make_parser()
    arguments = parser.parse_args()
    for directory in arguments.set_directories:
        if not os.path.isdir(directory):
            parser.error(f"{directory} is not a directory")
    options = SetOptions(arguments.root_link, arguments.root_title, arguments.title, arguments.toc, arguments.share,
                         arguments.exclude, arguments.jobs)
    for directory in map(os.path.abspath, arguments.set_directories):
        if not make_docdata(directory, options):
            parser.exit(1, f"pagemeld-docdata: {directory} has no pages\n")
