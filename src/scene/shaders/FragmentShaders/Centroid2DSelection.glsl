// The id of a centroid, within its disc.
uniform vec3 u_SelectionId;

varying vec2 v_UV;

void main()
{
	if (dot(v_UV, v_UV) > 1.0)
		discard;
	gl_FragColor = vec4(u_SelectionId, 1.0 / 255.0);
}
