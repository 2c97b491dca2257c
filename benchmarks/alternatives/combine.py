"""Combines documentation modules: what pagemeld does with sound input, as a build script in Python.

Usage: combine.py <module root> ...
"""

import gc
import json
import os
import sys


def read_json(path):
    with open(path, encoding="utf-8") as file:
        return json.load(file)


def write_output(path, *texts):
    with open(path + ".tmp", "wb") as file:
        file.writelines(texts)
    os.replace(path + ".tmp", path)


def combine_indexes(documents):
    pages, info, terms, common = [], [], {}, {}
    for module, document in enumerate(documents):
        page_offset, info_offset = len(pages), len(info)
        common = common or document["common"]
        pages += [[link, title, module] for link, title in document["pages"]]
        info += [[text, page + page_offset] for text, page in document["info"]]
        for term, numbers in document["searchIndex"].items():
            terms.setdefault(term, []).extend([number + info_offset for number in numbers])
    return {"pages": pages, "info": info, "common": common, "searchIndex": terms}


def tag(node, module):
    node["module"] = module
    for child in node["children"] or ():
        tag(child, module)


def key_of(node):
    return node["link"], node["title"]


def merge_node(target, source, siblings):
    """Siblings leads from a list of the combined tree, by its identity, to its nodes by their keys."""
    if source["children"] is None:
        return
    if target["children"] is None:
        target["children"] = source["children"]
        return
    nodes = target["children"]
    if id(nodes) not in siblings:
        siblings[id(nodes)] = {key_of(node): node for node in reversed(nodes)}
    known = siblings[id(nodes)]
    for node in source["children"]:
        same = known.setdefault(key_of(node), node)
        if same is node:
            nodes.append(node)
        else:
            merge_node(same, node, siblings)


def combine_tocs(documents):
    for module, document in enumerate(documents):
        tag(document, module)
    toc, *others = documents
    siblings = {}
    for other in others:
        if key_of(other) == key_of(toc):
            merge_node(toc, other, siblings)
    return toc


def pretty(value):
    return json.dumps(value, ensure_ascii=False, indent=4)


def compact(value):
    return json.dumps(value, ensure_ascii=False, separators=(",", ":"))


def quoted(text):
    return '"' + text.replace('"', '\\"') + '"'


def index_script(index):
    rows = ",\n".join(f'[p{module} + "{link}", {quoted(title)}]' for link, title, module in index["pages"])
    return (
        f"pages = [\n{rows}\n];\ninfo = {compact(index['info'])}\n"
        f"common = {compact(index['common'])};\nsearchIndex = {compact(index['searchIndex'])};\n"
    )


def nodes_script(nodes):
    return ",".join(map(node_script, nodes or ()))


def node_script(node):
    link = f'"{node["link"]}"' if node["link"] == "null" else f'p{node["module"]}+"{node["link"]}"'
    children = "null" if node["children"] is None else f'[{nodes_script(node["children"])}]'
    return f'{{"link": {link},"title": {quoted(node["title"])},"children": {children}}}'


def toc_script(toc):
    link, title = quoted(toc["link"]), quoted(toc["title"])
    return f'toc = {{\n"link": {link},"title": {title},"children": [{nodes_script(toc["children"])}]}};\n'


def prefix_variables(module_path, module_paths):
    prefixes = (os.path.relpath(other, module_path) for other in module_paths)
    return "".join(f'var p{i} = "{"" if prefix == "." else prefix + "/"}";\n' for i, prefix in enumerate(prefixes))


def combine_set(module_roots, set_name):
    module_paths = [f"{root}/{set_name}" for root in module_roots]
    index = combine_indexes([read_json(f"{module}/docdata/index.json") for module in module_paths])
    toc = combine_tocs([read_json(f"{module}/docdata/toc.json") for module in module_paths])
    texts = [text.encode() for text in (pretty(index), index_script(index), pretty(toc), toc_script(toc))]
    index_json, index_js, toc_json, toc_js = texts
    for module in module_paths:
        prefixes = prefix_variables(module, module_paths).encode()
        write_output(f"{module}/docdata/global_index.json", index_json)
        write_output(f"{module}/docdata/global_index.js", prefixes, index_js)
        write_output(f"{module}/docdata/global_toc.json", toc_json)
        write_output(f"{module}/docdata/global_toc.js", prefixes, toc_js)


if __name__ == "__main__":
    gc.disable()  # a quarter faster: the run makes no cycles, and few objects die
    sys.setrecursionlimit(20_000)  # for a deep table of contents
    for name in ("Manual", "ScriptReference"):
        combine_set(sys.argv[1:], name)
