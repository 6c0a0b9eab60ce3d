"""The parts of a Markdown file that are written by a program: what stands between `<!-- NAME -->` and the
`<!-- end -->` that follows. All else is left as it is."""


def with_block(document, name, content):
    mark, end = f"<!-- {name} -->\n", "<!-- end -->"
    if document.count(mark) != 1:
        raise ValueError(f"the document has {document.count(mark)} blocks <!-- {name} --> where one belongs")
    before, rest = document.split(mark)
    _, found, after = rest.partition(end)
    if not found:
        raise ValueError(f"the block <!-- {name} --> of the document has no {end}")
    return f"{before}{mark}\n{content}\n\n{end}{after}"
