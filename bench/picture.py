"""The picture of the whole runs: seconds over hot folders, both axes logarithmic, and where the time goes."""
import math

WIDTH, HEIGHT = 760, 560
LEFT, RIGHT, TOP, BOTTOM = 70, 600, 40, 380
SERIES = (('logged', 'tool, log on', '#b5432a'), ('tool', 'tool, log off', '#1f5fa8'), ('floor', 'floor', '#6d6d6d'),
          ('script', 'script', '#3c8a4e'))
COLOURS = ('#c9c9c9', '#1f5fa8', '#6a9fd8', '#a9c8ea', '#3c8a4e', '#d99a2b', '#8d5fa8', '#b5432a', '#444444')
BAR_TOP, BAR_HEIGHT = 440, 26


def text(x, y, content, extra=''):
    return f'<text x="{x:.0f}" y="{y:.0f}" {extra}>{content}</text>'


class Axes:
    def __init__(self, results):
        times = [now[name] for now in results for name, _, _ in SERIES if name in now]
        self.decades = [math.floor(math.log10(min(times))), math.ceil(math.log10(max(times)))]
        self.counts = [now['count'] for now in results]

    def x(self, count):
        first, last = math.log10(self.counts[0]), math.log10(self.counts[-1])
        return LEFT + (RIGHT - LEFT) * (math.log10(count) - first) / max(last - first, 1)

    def y(self, seconds):
        low, high = self.decades
        return BOTTOM - (BOTTOM - TOP) * (math.log10(seconds) - low) / (high - low)

    def draw(self):
        parts = []
        for decade in range(self.decades[0], self.decades[1] + 1):
            y = self.y(10 ** decade)
            parts += [f'<path d="M{LEFT} {y:.0f}H{RIGHT}" stroke="#dddddd"/>',
                      text(LEFT - 8, y + 4, f'{10 ** decade:g} s', 'text-anchor="end"')]
        for count in self.counts:
            x = self.x(count)
            parts += [f'<path d="M{x:.0f} {TOP}V{BOTTOM}" stroke="#dddddd"/>',
                      text(x, BOTTOM + 18, f'{count:,}', 'text-anchor="middle"')]
        return parts + [text((LEFT + RIGHT) / 2, BOTTOM + 36, 'hot folders', 'text-anchor="middle"')]


def draw_lines(results, axes):
    parts, labels = [], []
    for name, label, colour in SERIES:
        points = [(axes.x(now['count']), axes.y(now[name])) for now in results if name in now]
        parts.append('<polyline fill="none" stroke-width="2" stroke="{}" points="{}"/>'.format(
            colour, ' '.join(f'{x:.1f},{y:.1f}' for x, y in points)))
        parts += [f'<circle cx="{x:.1f}" cy="{y:.1f}" r="3" fill="{colour}"/>' for x, y in points]
        labels.append([points[-1][1] + 4, points[-1][0] + 10, label, colour])
    labels.sort()
    for above, below in zip(labels, labels[1:]):
        below[0] = max(below[0], above[0] + 15)
    return parts + [text(x, y, label, f'fill="{colour}"') for y, x, label, colour in labels]


def draw_shares(results):
    now = next((each for each in results if each['count'] == 1000), results[-1])
    kinds = sorted(now['shares'].items(), key=lambda kind: -kind[1])
    total = sum(spent for _, spent in kinds)
    parts = [text(LEFT, BAR_TOP - 8, f"where the time goes, log off, {now['count']:,} folders")]
    x = LEFT
    shown = [kind for kind in kinds if kind[1] >= total / 200]
    for index, ((kind, spent), colour) in enumerate(zip(shown, COLOURS[1:] + COLOURS[:1])):
        width = (RIGHT - LEFT) * spent / total
        parts.append(f'<rect x="{x:.1f}" y="{BAR_TOP}" width="{width:.1f}" height="{BAR_HEIGHT}" fill="{colour}"/>')
        x += width
        column, row = LEFT + 190 * (index % 3), BAR_TOP + BAR_HEIGHT + 22 + 20 * (index // 3)
        parts += [f'<rect x="{column}" y="{row - 10}" width="11" height="11" fill="{colour}"/>',
                  text(column + 17, row, f'{kind}, {100 * spent / total:.0f} %')]
    return parts


def draw(results):
    axes = Axes(results)
    parts = [f'<svg xmlns="http://www.w3.org/2000/svg" viewBox="0 0 {WIDTH} {HEIGHT}" '
             'font-family="sans-serif" font-size="13" fill="#222222">',
             f'<rect width="{WIDTH}" height="{HEIGHT}" fill="#ffffff"/>',
             text(LEFT, TOP - 14, 'A whole run, both axes logarithmic'), *axes.draw(),
             *draw_lines(results, axes), *draw_shares(results), '</svg>']
    return '\n'.join(parts) + '\n'
