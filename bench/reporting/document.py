"""The parts of a Markdown file that are written by a program: what stands between `<!-- NAME -->` and the
`<!-- end -->` that follows. All else is left as it is."""

import re


def _block(name):
    return re.compile(rf"(?<=<!-- {re.escape(name)} -->\n).*?(?=<!-- end -->)", re.DOTALL)


def block_names(document):
    return [name for name in re.findall(r"<!-- ([\w-]+) -->", document) if name != "end"]


def with_block(document, name, content):
    replaced, count = _block(name).subn(lambda _: f"\n{content}\n\n", document)
    if count != 1:
        raise ValueError(f"the document has {count} blocks <!-- {name} --> where one belongs")
    return replaced
