// A square of a mask, with a line round it.
uniform vec4 u_ModelColour;

varying vec2 v_UV;

void main()
{
	vec2 edge = min(v_UV, 1.0 - v_UV);
	float line = 1.0 - step(0.05, min(edge.x, edge.y));
	gl_FragColor = vec4(u_ModelColour.rgb, mix(0.5 * u_ModelColour.a, u_ModelColour.a, line));
}
