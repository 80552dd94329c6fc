# SPDX-License-Identifier: Apache-2.0
"""A Markdown file as HTML, with its links, its headings' anchors and its diagrams."""

import collections
import html
import re

from markdown_it import MarkdownIt

import diagrams
import links

# Each link is (line, target as written, href as given by resolve, resource).
Page = collections.namedtuple("Page", "title summary body links")


def render(text, source, resolve):
    """resolve makes the href of a link's target; source names the file in problems."""
    parser = MarkdownIt("commonmark").enable("table").enable("strikethrough")
    tokens = parser.parse(text)
    number_headings(tokens)
    found = []
    line = 0
    for token in tokens:
        line = token.map[0] + 1 if token.map else line
        if token.type == "inline":
            found += rewrite_inline(token, line, resolve)
        elif token.type == "html_block":
            found += links_in_html(token, line, resolve)
    draw(tokens, source)
    body = parser.renderer.render(tokens, parser.options, {})
    return Page(title_of(tokens, source), summary_of(tokens), body, found)


def rewrite_inline(token, line, resolve):
    found = []
    for child in token.children:
        if child.type in ("softbreak", "hardbreak"):
            line += 1
        elif child.type in ("link_open", "image"):
            name = "href" if child.type == "link_open" else "src"
            target = child.attrGet(name)
            child.attrSet(name, resolve(target))
            found.append((line, target, child.attrGet(name), name == "src"))
        elif child.type == "html_inline":
            found += links_in_html(child, line, resolve)
    return found


def links_in_html(token, first_line, resolve):
    found = []
    for line, target, resource in links.Reader(token.content).links:
        href = resolve(target)
        token.content = token.content.replace(
            f'"{html.escape(target)}"', f'"{html.escape(href)}"')
        found.append((first_line + line - 1, target, href, resource))
    return found


def number_headings(tokens):
    """The anchors that a repository's viewer makes, too."""
    seen = collections.Counter()
    for opening, content in zip(tokens, tokens[1:]):
        if opening.type == "heading_open":
            slug = re.sub(r"[^\w\- ]", "", text_of(content).lower()).replace(" ", "-")
            opening.attrSet("id", f"{slug}-{seen[slug]}" if seen[slug] else slug)
            seen[slug] += 1


def draw(tokens, source):
    """Diagrams in place of the blocks that describe them."""
    count = 0
    for token in tokens:
        if token.type == "fence" and token.info.strip() == "dot":
            count += 1
            svg = diagrams.svg_of(token.content, source, token.map[0] + 2)
            token.type, token.content = "html_block", (
                f'<figure class="diagram">\n{diagrams.inline(svg, count)}</figure>\n')


def text_of(inline):
    kept = (child for child in inline.children
            if child.type in ("text", "code_inline", "softbreak"))
    return "".join(" " if child.type == "softbreak" else child.content for child in kept)


def title_of(tokens, source):
    for opening, content in zip(tokens, tokens[1:]):
        if opening.type == "heading_open":
            return text_of(content)
    return str(source)


def summary_of(tokens):
    """The first sentence of what stands below the title."""
    for heading, opening, content in zip(tokens, tokens[1:], tokens[2:]):
        if heading.type == "heading_close" and opening.type == "paragraph_open":
            return re.split(r"(?<=[.:])\s", text_of(content))[0].rstrip(":")
        if heading.type == "heading_close":
            break
    return ""
