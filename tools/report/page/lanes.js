// The states, a lane each.
function addLanes(one, figure) {
    const plot = figure.querySelector('.plot');
    const lanes = one.lanes.map(lane => {
        const segments = [];
        let at = 0;
        for (let i = 0; i < lane.segments.length; i += 3) {
            const from = at + lane.segments[i];
            at = from + lane.segments[i + 1];
            segments.push([from, at, lane.segments[i + 2]]);
        }
        return {name: lane.name, texts: lane.texts, segments};
    });
    const rowHeight = 40, barHeight = 20;
    plot.style.height = lanes.length * rowHeight + 22 + 'px';
    const canvas = make('canvas', 'graph', plot);
    const hair = make('div', 'hair', plot), selection = make('div', 'select', plot);
    const pixel = follow(plot, selection);
    const textOf = (lane, segment) => (segment[2] < 0 ? lane.texts[-1 - segment[2]] + ' and others' : lane.texts[segment[2]]);
    function draw() {
        const width = plot.clientWidth, height = plot.clientHeight, scale = devicePixelRatio || 1;
        canvas.width = Math.round(width * scale);
        canvas.height = Math.round(height * scale);
        Object.assign(canvas.style, {width: width + 'px', height: height + 'px'});
        const pen = canvas.getContext('2d');
        pen.scale(scale, scale);
        const family = getComputedStyle(document.body).fontFamily;
        const ink = colour('ink'), soft = colour('soft'), hairline = colour('hair');
        const tints = [0, 1, 2, 3, 4, 5].map(i => colour('t' + i));
        lanes.forEach((lane, row) => {
            const top = row * rowHeight;
            pen.font = '12px ' + family;
            pen.fillStyle = soft;
            pen.fillText(lane.name, left, top + 13);
            pen.font = '12px ' + family;
            let drawn = -Infinity;
            for (const segment of lane.segments) {
                if (segment[1] < range[0] || segment[0] > range[1]) continue;
                const from = pixel(Math.max(segment[0], range[0])), to = pixel(Math.min(segment[1], range[1]));
                if (to - drawn < 0.5) continue;
                drawn = to;
                pen.fillStyle = tints[(segment[2] < 0 ? -1 - segment[2] : segment[2]) % tints.length];
                const wide = Math.max(to - from, 1);
                pen.fillRect(from, top + 18, wide > 3 ? wide - 1 : wide, barHeight);
                const text = textOf(lane, segment);
                if (wide < 24) continue;
                pen.fillStyle = ink;
                if (pen.measureText(text).width <= wide - 8) pen.fillText(text, from + 4, top + 18 + 14);
                else if (wide > 60) {
                    pen.save();
                    pen.beginPath();
                    pen.rect(from, top + 18, wide - 5, barHeight);
                    pen.clip();
                    pen.fillText(text, from + 4, top + 18 + 14);
                    pen.restore();
                }
            }
        });
        const bottom = lanes.length * rowHeight + 2;
        pen.strokeStyle = hairline;
        pen.fillStyle = soft;
        pen.textAlign = 'center';
        for (const tick of ticks(range[0], range[1], width - left)) pen.fillText(tick.label, pixel(tick.v), bottom + 14);
        pen.beginPath();
        pen.moveTo(left, bottom + 0.5);
        pen.lineTo(width - right, bottom + 0.5);
        pen.stroke();
    }
    const several = data.drives.length > 1 ? one.name + ' ' : '';
    const told = ['Serving cell', 'State', 'Registration', 'Service'];
    views.push({
        draw, theme: draw,
        read: (x, parts) => {
            const seen = x !== null && x >= range[0] && x <= range[1];
            hair.style.display = seen ? 'block' : 'none';
            if (seen) hair.style.left = pixel(x) + 'px';
            if (x === null) return;
            const texts = [];
            for (const lane of lanes) {
                if (!told.includes(lane.name)) continue;
                const segment = lane.segments.find(([from, to]) => from <= x && x < to);
                if (segment) texts.push(`${several}${lane.name.toLowerCase()} ${textOf(lane, segment)}`);
            }
            parts.unshift(...texts);
        },
    });
    new ResizeObserver(draw).observe(plot);
}
