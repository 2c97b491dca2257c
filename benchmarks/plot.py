"""Draws studies as one SVG picture: wall time of the sizes as bars, CPU of the series as lines."""

from html import escape
from math import log2

COLOURS = {"limit": "#9aa5b1", "pagemeld": "#1f6feb", "node": "#3fa34d", "python": "#d9822b"}
SERIES_COLOURS = {"terms": "#1f6feb", "siblings": "#d9822b"}
WIDTH = 760
LEFT = 170
BAR_HEIGHT = 16
CHART_HEIGHT = 260


def draw(studies):
    picture = Picture()
    for study in studies:
        for size, rounds in study.sizes.items():
            draw_bars(picture, f"{size}, {study.file_system}", rounds)
    for study in studies:
        if study.series:
            draw_series(picture, study)
    return picture.text()


def draw_bars(picture, title, rounds):
    """Draws one bar a contender, all on the scale of the slowest."""
    walls = {name: rounds.median(name, "wall") for name in rounds.names()}
    scale = (WIDTH - LEFT - 130) / max(walls.values())
    picture.title(f"Wall time: {title}")
    for name, wall in walls.items():
        picture.write(LEFT - 10, picture.y + 12, name, "end")
        picture.rectangle(LEFT, wall * scale, BAR_HEIGHT - 3, COLOURS[name])
        ratio = rounds.ratio(name, "limit", "wall")
        picture.write(LEFT + wall * scale + 6, picture.y + 12, f"{wall:.3g} s, {ratio:.2f} x limit")
        picture.y += BAR_HEIGHT


def draw_series(picture, study):
    """Draws CPU over count, each step of the grid a doubling on both axes: a straight diagonal is linear cost."""
    picture.title(f"CPU by number of distinct terms and of siblings ({study.file_system}); both axes double")
    steps = [step for series in study.series.values() for step in series]
    first_count = log2(min(count for count, _, _ in steps))
    first_cpu = log2(min(cpu for _, cpu, _ in steps))
    unit = min(
        (WIDTH - LEFT - 130) / (log2(max(count for count, _, _ in steps)) - first_count),
        (CHART_HEIGHT - 30) / (log2(max(cpu for _, cpu, _ in steps)) - first_cpu),
    )
    bottom = picture.y + CHART_HEIGHT - 20
    for name, series in study.series.items():
        points = [
            (LEFT + (log2(count) - first_count) * unit, bottom - (log2(cpu) - first_cpu) * unit)
            for count, cpu, _ in series
        ]
        picture.line(points, SERIES_COLOURS[name])
        for (x, y), (count, cpu, _) in zip(points, series):
            picture.dot(x, y, SERIES_COLOURS[name], f"{count:,} {name}: {cpu:.3f} s")
        picture.write(points[-1][0] + 8, points[-1][1] + 4, f"{name}: {series[-1][0]:,} in {series[-1][1]:.2f} s")
    picture.y += CHART_HEIGHT


class Picture:
    def __init__(self):
        self.y = 10
        self._parts = []

    def title(self, text):
        self.y += 24
        self._parts.append(f'<text x="10" y="{self.y}" font-weight="bold">{escape(text)}</text>')
        self.y += 10

    def write(self, x, y, text, anchor="start"):
        self._parts.append(f'<text x="{x:.1f}" y="{y:.1f}" text-anchor="{anchor}">{escape(text)}</text>')

    def rectangle(self, x, width, height, colour):
        shape = f'x="{x}" y="{self.y}" width="{width:.1f}" height="{height}"'
        self._parts.append(f'<rect {shape} fill="{colour}"/>')

    def line(self, points, colour):
        path = " ".join(f"{x:.1f},{y:.1f}" for x, y in points)
        self._parts.append(f'<polyline points="{path}" fill="none" stroke="{colour}" stroke-width="2"/>')

    def dot(self, x, y, colour, label):
        circle = f'<circle cx="{x:.1f}" cy="{y:.1f}" r="4" fill="{colour}">'
        self._parts.append(f"{circle}<title>{escape(label)}</title></circle>")

    def text(self):
        head = f'<svg xmlns="http://www.w3.org/2000/svg" viewBox="0 0 {WIDTH} {self.y + 10}" '
        style = 'font-family="sans-serif" font-size="12" fill="#24292f">'
        background = '<rect width="100%" height="100%" fill="#ffffff"/>'
        return "\n".join([head + style, background, *self._parts, "</svg>"]) + "\n"
