// One chart. Of each step the smallest reading, the mean and the largest.
const none = [NaN, NaN, NaN];
function lineOf(line) {
    const x = [], y = [];
    let at = 0;
    line.x.forEach((difference, i) => {
        if (i > 0 && difference > longestLine) { x.push(at + 1); y.push(none); }
        at += difference;
        x.push(at);
        const value = line.y[i];
        y.push(value === null ? none : typeof value === 'number' ? [value, value, value] : value);
    });
    return {x, y};
}
// A break and the reading after it may share their time.
function merged(lines) {
    const rows = [];
    const next = lines.map(() => 0);
    for (;;) {
        let x = Infinity;
        lines.forEach((line, i) => { if (next[i] < line.x.length) x = Math.min(x, line.x[next[i]]); });
        if (x === Infinity) return rows;
        const row = [x];
        lines.forEach((line, i) => row.push(next[i] < line.x.length && line.x[next[i]] === x ? line.y[next[i]++] : null));
        rows.push(row);
    }
}
function valueAt(line, x) {
    let low = 0, high = line.x.length - 1;
    if (high < 0 || line.x[0] > x) return null;
    while (low < high) {
        const middle = (low + high + 1) >> 1;
        if (line.x[middle] <= x) low = middle; else high = middle - 1;
    }
    return line.y[low] === none || x - line.x[low] > longestLine ? null : line.y[low];
}
const marks = data.drives.map(one => ({x: sums(one.marks.x), kinds: one.marks.kinds}));
function worded(value, unit) {
    const range = value[0] === value[2] ? '' : ` (${value[0]} to ${value[2]})`;
    return value[1] + (unit ? ' ' + unit : '') + range;
}
function drawMarks(canvas, area, graph) {
    canvas.strokeStyle = colour('mark');
    canvas.lineWidth = 1;
    marks.forEach((mark, i) => {
        const seen = mark.x.filter(x => x >= range[0] && x <= range[1]).length;
        const full = marks.length === 1 && seen <= Math.max(20, area.w / 9);
        let drawn = -Infinity;
        mark.x.forEach((x, k) => {
            if (x < range[0] || x > range[1]) return;
            const at = Math.round(graph.toDomXCoord(x)) + 0.5;
            const top = area.y + 6 * i;
            if (!full && at - drawn < 2) return;
            drawn = at;
            canvas.setLineDash(mark.kinds[k] === 'h' ? [] : [2, 3]);
            canvas.beginPath();
            canvas.moveTo(at, top);
            canvas.lineTo(at, full ? area.y + area.h : top + 6);
            canvas.stroke();
        });
    });
    if (data.axis === 'clock') {
        canvas.setLineDash([1, 2]);
        canvas.strokeStyle = colour('ink');
        for (const [x] of drive.stretches.slice(1)) {
            if (x <= range[0] || x >= range[1]) continue;
            const at = Math.round(graph.toDomXCoord(x)) + 0.5;
            for (const side of [-1.5, 1.5]) {
                canvas.beginPath();
                canvas.moveTo(at + side, area.y);
                canvas.lineTo(at + side, area.y + area.h);
                canvas.stroke();
            }
        }
    }
    canvas.setLineDash([]);
}
function drawGrades(canvas, area, graph, grades) {
    const [low, high] = graph.yAxisRange();
    for (const [name, floor] of grades) {
        if (floor <= low || floor >= high) continue;
        const y = Math.round(graph.toDomYCoord(floor)) + 0.5;
        canvas.strokeStyle = colour('mark');
        canvas.setLineDash([1, 4]);
        canvas.beginPath();
        canvas.moveTo(area.x, y);
        canvas.lineTo(area.x + area.w, y);
        canvas.stroke();
    }
    canvas.setLineDash([]);
}
// Above the lines, on a rim of the paper's colour.
function nameGrades(canvas, area, graph, grades) {
    const [low, high] = graph.yAxisRange();
    canvas.font = 'italic 11px ' + getComputedStyle(document.body).fontFamily;
    canvas.textAlign = 'right';
    canvas.lineWidth = 4;
    canvas.lineJoin = 'round';
    canvas.strokeStyle = colour('paper');
    canvas.fillStyle = colour('soft');
    for (const [name, floor] of grades) {
        if (floor <= low || floor >= high) continue;
        const x = area.x + area.w - 3, y = Math.round(graph.toDomYCoord(floor)) - 3;
        canvas.strokeText(name, x, y);
        canvas.fillText(name, x, y);
    }
}
function addChart(chart, figure) {
    const plot = figure.querySelector('.plot');
    const lines = chart.lines.map(lineOf);
    const hair = make('div', 'hair', plot), selection = make('div', 'select', plot);
    const dots = lines.map(() => make('div', 'dot', plot));
    const values = [...figure.querySelectorAll('output')];
    const colours = () => chart.lines.map(line => colour('l' + line.style));
    const series = {};
    chart.lines.forEach(line => { series[line.name] = {strokePattern: dashes[line.style], strokeWidth: 1.6}; });
    const theme = () => ({colors: colours(), gridLineColor: colour('grid'), axisLineColor: colour('hair')});
    const graph = new Dygraph(plot.querySelector('.graph'), merged(lines), {
        ...theme(), series, customBars: true, fillAlpha: 0.16, labels: ['x', ...chart.lines.map(line => line.name)], dateWindow: range, legend: 'never',
        connectSeparatedPoints: true, interactionModel: {}, highlightCircleSize: 0, rightGap: right, xRangePad: 0, yRangePad: 12,
        axes: {
            x: {ticker: (from, to, width) => ticks(from, to, width), drawGrid: false, axisLabelWidth: 90},
            y: {axisLabelWidth: left - 6, pixelsPerLabel: 34, axisLabelFormatter: number => String(Number(number.toPrecision(6)))},
        },
        underlayCallback: (canvas, area, drawn) => {
            drawGrades(canvas, area, drawn, chart.grades);
            drawMarks(canvas, area, drawn);
        },
        plugins: [{activate: () => ({didDrawChart: event =>
            nameGrades(event.drawingContext, event.dygraph.getArea(), event.dygraph, chart.grades)})}],
    });
    const pixel = follow(plot, selection);
    const scaled = [Infinity, -Infinity];
    for (const line of lines) for (const [low,, high] of line.y) { if (low < scaled[0]) scaled[0] = low; if (high > scaled[1]) scaled[1] = high; }
    if (scaled[0] === scaled[1]) graph.updateOptions({valueRange: [scaled[0] - 1, scaled[1] + 1]});
    views.push({
        draw: () => graph.updateOptions({dateWindow: range}),
        theme: () => graph.updateOptions(theme()),
        read: (x, parts) => {
            const seen = x !== null && x >= range[0] && x <= range[1];
            hair.style.display = seen ? 'block' : 'none';
            if (seen) hair.style.left = pixel(x) + 'px';
            lines.forEach((line, i) => {
                const value = x === null ? null : valueAt(line, x);
                values[i].textContent = value === null ? '' : worded(value, chart.unit);
                dots[i].style.display = seen && value !== null ? 'block' : 'none';
                if (value === null) return;
                if (seen) {
                    Object.assign(dots[i].style, {left: pixel(x) + 'px', top: graph.toDomYCoord(value[1]) + 'px',
                        background: colour('l' + chart.lines[i].style)});
                }
                parts.push(`${chart.measure}${chart.lines[i].name} ${worded(value, chart.unit)}`);
            });
        },
    });
}
