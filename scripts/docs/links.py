"""Every relative link and anchor of the Markdown pages leads somewhere."""

from pages import is_outside, target_of


def link_faults(pages):
    """One line for each link that leads nowhere."""
    by_path = {page.path: page for page in pages}
    faults = []
    for page in pages:
        for link in page.links:
            if is_outside(link.target):
                continue
            path, anchor = target_of(page, link.target)
            if not path.exists():
                faults.append(f"{page.name}:{link.line}: no such file: {link.target}")
            elif anchor and path not in by_path:
                faults.append(f"{page.name}:{link.line}: an anchor in what is no page: {link.target}")
            elif anchor and anchor not in by_path[path].anchors.values():
                faults.append(f"{page.name}:{link.line}: no such heading: {link.target}")
    return faults
